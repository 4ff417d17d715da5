#include "base/codepage.h"
#include "settings/datafolder.h"
#include "settings/profilefile.h"
#include "support/sourcefolder.h"

#include <algorithm>
#include <filesystem>
#include <map>
#include <set>
#include <string>
#include <string_view>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace kdx {
namespace {

using ::testing::Not;
using ::testing::SizeIs;

constexpr std::string_view kHalves = " / ";  // between the German and the English half

struct Event {
    std::string code;
    std::string german;
    std::string english;
};

std::vector<std::string> pieces(const std::string& text, std::string_view end) {
    std::vector<std::string> found;
    std::size_t start = 0;
    for (std::size_t at = 0; (at = text.find(end, start)) != std::string::npos; start = at + end.size())
        found.push_back(text.substr(start, at - start));
    if (start < text.size()) found.push_back(text.substr(start));
    return found;
}

std::string contentOf(const std::filesystem::path& file) {
    const auto content = readFile(file);
    EXPECT_TRUE(content.has_value()) << file;
    return content.value_or("");
}

/// The shipped list, a half that is missing being empty.
std::vector<Event> shippedEvents() {
    std::vector<Event> events;
    for (const std::string& line : pieces(contentOf(DataFolder(test::sourceFolder()).file(kEventList)), "\r\n")) {
        const std::size_t semicolon = line.find(';');
        if (semicolon == std::string::npos) {
            ADD_FAILURE() << "no code: " << line;
            continue;
        }
        std::vector<std::string> halves = pieces(line.substr(0, semicolon), kHalves);
        EXPECT_THAT(halves, SizeIs(2)) << line;
        halves.resize(2);
        events.push_back({line.substr(semicolon + 1), halves[0], halves[1]});
    }
    return events;
}

/// What every shipped code says in English, kept apart from the list: a receiver shows its own text for the code, so
/// a line whose code and text do not belong together sends something else than the user chose.
std::map<std::string, std::string> meanings() {
    const std::filesystem::path file = test::sourceFolder() / "tests/settings/event_meanings.tsv";
    std::map<std::string, std::string> byCode;
    for (const std::string& line : pieces(contentOf(file), "\n")) {
        const std::vector<std::string> fields = pieces(line, "\t");
        if (fields.size() != 2) {
            ADD_FAILURE() << "not a code and a meaning: " << line;
            continue;
        }
        EXPECT_TRUE(byCode.emplace(fields[0], fields[1]).second) << "code again: " << line;
    }
    return byCode;
}

TEST(EventList, EveryCodeSaysWhatItIsKnownToMean) {
    std::map<std::string, std::string> shipped;
    for (const Event& event : shippedEvents()) shipped[event.code] = event.english;
    const std::map<std::string, std::string> known = meanings();
    for (const auto& [code, english] : shipped) {
        const auto meaning = known.find(code);
        EXPECT_EQ(english, meaning == known.end() ? "no known code" : meaning->second) << code;
    }
    for (const auto& [code, english] : known) EXPECT_TRUE(shipped.contains(code)) << code << " " << english;
    EXPECT_THAT(shipped, Not(::testing::IsEmpty()));
}

TEST(EventList, EitherHalfAloneTellsTheEventsApart) {
    std::set<std::string> german;
    std::set<std::string> english;
    for (const Event& event : shippedEvents()) {
        EXPECT_TRUE(german.insert(upperCase(event.german)).second) << event.code << " " << event.german;
        EXPECT_TRUE(english.insert(upperCase(event.english)).second) << event.code << " " << event.english;
    }
}

TEST(EventList, StandsInTheOrderOfTheCodes) {
    const std::vector<Event> events = shippedEvents();
    EXPECT_TRUE(std::ranges::is_sorted(events, {}, &Event::code));
}

}  // namespace
}  // namespace kdx
