#include "scenario/values.h"

#include <algorithm>

#include "base/codepage.h"
#include "base/duration.h"
#include "base/numbers.h"
#include "base/printable.h"
#include "coder/keyfacts.h"
#include "scenario/scenario.h"

namespace kdx::scenario {

namespace {

constexpr std::string_view kTimes = "500 ms, 2 s, 1.5 min or 1 h";
constexpr std::int64_t kOne = 1'000'000;  // of a decimal

std::string quoted(std::string_view text) {
    return "\"" + std::string(text) + "\"";
}

}  // namespace

std::optional<std::string> Values::text(const YamlNode& node, std::string_view name) {
    const std::string subject(name);
    if (node.kind == YamlNode::Kind::Nothing) {
        wrong(node, subject + R"( has no value; an empty text is written "", a word like null in quotation marks)");
        return std::nullopt;
    }
    if (node.kind != YamlNode::Kind::Text) {
        wrong(node, subject + " takes one value, no list and no further names");
        return std::nullopt;
    }
    std::string text = node.text;
    if (text.ends_with('\n')) text.pop_back();  // a text over several lines ends so
    if (std::any_of(text.begin(), text.end(), isControl)) {
        wrong(node, subject + " holds a line end or another control character");
        return std::nullopt;
    }
    return text;
}

std::optional<std::string> Values::instrumentText(const YamlNode& node, std::string_view name) {
    const auto utf8 = text(node, name);
    if (!utf8) return std::nullopt;
    const std::string_view foreign = firstOutsideCodePage(*utf8);
    if (foreign.empty()) return fromUtf8(*utf8);
    // The very place is known when the file holds the text as it is, without escapes.
    const auto at = static_cast<std::size_t>(foreign.data() - utf8->data());
    const std::string_view before = std::string_view(*utf8).substr(0, at);
    const bool literal = m_problems.text().substr(std::min(node.at, m_problems.text().size())).starts_with(before);
    m_problems.add(literal ? node.at + at : node.at, std::string(name) + ": " + noSuchCharacter(foreign));
    return std::nullopt;
}

std::optional<std::string> Values::keyValue(const YamlNode& node, const std::string& key) {
    const KeyFacts* facts = factsOf(key);
    const bool matters = facts == nullptr || !facts->range.empty();
    if (!matters && node.kind == YamlNode::Kind::Nothing) return std::string();
    const auto value = instrumentText(node, key);
    if (!value || !isLegal(node, key, *value)) return std::nullopt;
    return correctedValue(key, *value, m_corrections);
}

std::optional<std::chrono::milliseconds> Values::time(const YamlNode& node, std::string_view name) {
    const auto written = text(node, name);
    if (!written) return std::nullopt;
    const auto time = parseDuration(*written);
    if (!time) {
        const bool unitMissing = parseDuration(*written + "s").has_value();
        wrong(node, std::string(name) + (unitMissing ? " needs a unit: " : " is a time: ") + std::string(kTimes) +
                        ", not " + quoted(*written));
    } else if (time->count() < 1 || *time > kLongestTime) {
        wrong(node, std::string(name) + " is 1 ms at least and 168 h at most, not " + quoted(*written));
    } else {
        return time;
    }
    return std::nullopt;
}

std::optional<unsigned> Values::whole(const YamlNode& node, std::string_view name, unsigned lowest, unsigned highest) {
    const auto written = text(node, name);
    if (!written) return std::nullopt;
    const auto value = isDecimal(*written) ? readDecimal(*written) : std::nullopt;
    if (value && value->millionths >= lowest * kOne && value->millionths <= highest * kOne)
        return static_cast<unsigned>(value->millionths / kOne);
    wrong(node, std::string(name) + " is a whole number, " + std::to_string(lowest) + " to " + std::to_string(highest) +
                    ", not " + quoted(*written));
    return std::nullopt;
}

std::optional<bool> Values::choice(const YamlNode& node, std::string_view name) {
    const auto written = text(node, name);
    if (!written) return std::nullopt;
    if (*written == "true" || *written == "false") return *written == "true";
    wrong(node, std::string(name) + " is true or false, not " + quoted(*written));
    return std::nullopt;
}

std::optional<Decimal> Values::number(const YamlNode& node, std::string_view name) {
    const auto written = text(node, name);
    if (!written) return std::nullopt;
    const auto value = readDecimal(*written);
    if (!value) {
        const bool comma = written->find(',') != std::string::npos;
        wrong(node, std::string(name) + (comma ? " is a number with a decimal point, not " : " is a number, not ") +
                        quoted(*written));
    }
    return value;
}

bool Values::isLegal(const YamlNode& node, const std::string& key, const std::string& value) {
    if (m_force) return true;
    const auto why = wrongValue(key, value, m_corrections);
    if (why) wrong(node, *why);
    return !why;
}

}  // namespace kdx::scenario
