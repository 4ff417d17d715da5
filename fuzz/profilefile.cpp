// Profile files: what is read is what a plain walk over the lines finds, and a value that is written reads back while
// every other one stays.
#include "harness.h"

#include "base/codepage.h"
#include "settings/profilefile.h"
#include "settings/withoutcontrols.h"

#include <map>
#include <utility>

namespace {

using kdx::fuzz::demand;
using Values = std::map<std::pair<std::string, std::string>, std::string>;  // by section and key in capitals

constexpr std::string_view kBlanks = " \t\v";

std::string trimmed(std::string_view text) {
    const std::size_t begin = text.find_first_not_of(kBlanks);
    if (begin == std::string_view::npos) return {};
    return std::string(text.substr(begin, text.find_last_not_of(kBlanks) - begin + 1));
}

std::string asRead(std::string_view written) {
    std::string value = trimmed(written);
    const bool quoted = value.size() > 1 && value.front() == value.back() && std::string_view("\"'").find(value[0]) < 2;
    if (quoted) value = value.substr(1, value.size() - 2);
    return value.substr(0, kdx::kLongestValue);
}

Values valuesOf(std::string_view bytes) {
    if (bytes.starts_with("\xEF\xBB\xBF")) bytes.remove_prefix(3);
    Values values;
    std::map<std::string, int> sections;  // how often each has begun; only its first time counts
    std::string section;
    for (const std::string_view piece : kdx::fuzz::split(bytes, "\r\n")) {
        const std::string line = trimmed(piece);
        if (line.empty() || line.front() == ';') continue;
        const std::size_t equals = line.find('=');
        if (line.front() == '[') {
            section = kdx::upperCase(trimmed(line.substr(1, line.find(']') - 1)));
            ++sections[section];
        } else if (!sections.empty() && sections[section] == 1) {
            const std::string key = kdx::upperCase(trimmed(line.substr(0, equals)));
            values.emplace(std::pair(section, key), equals == std::string::npos ? "" : asRead(line.substr(equals + 1)));
        }
    }
    return values;
}

/// A name as the program has them: of one line, and none of the signs by which a line is taken apart.
std::string nextName(FuzzedDataProvider& input, std::string_view signs) {
    const std::string name = trimmed(kdx::withoutControls(kdx::fuzz::nextText(input)));
    return name.find_first_of(signs) == std::string::npos ? name : "RDS";
}

}  // namespace

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    FuzzedDataProvider input(data, size);
    const std::string section = nextName(input, "]");
    const std::string key = nextName(input, "[;=");
    const std::string value = kdx::withoutControls(kdx::fuzz::nextText(input));
    kdx::ProfileText text(input.ConsumeRemainingBytesAsString());

    Values expected = valuesOf(text.bytes());
    const auto compare = [&] {
        for (const auto& [name, held] : expected) demand(text.value(name.first, name.second) == held, "a value reads");
        demand(valuesOf(text.bytes()) == expected, "the file holds those values and no others");
    };
    compare();
    text.setValue(section, key, value);
    expected[{kdx::upperCase(section), kdx::upperCase(key)}] = asRead(value);
    compare();
    const std::string once = text.bytes();
    demand(text.holds(section, key, value), "the file knows that it holds the value");
    text.setValue(section, key, value);
    demand(text.bytes() == once, "writing the same again changes nothing");
    return 0;
}
