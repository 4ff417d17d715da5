#pragma once

#include <chrono>
#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace kdx::scenario {

// What a scenario may ask for at most.
inline constexpr std::size_t kLargestFile = std::size_t{512} * 1024;
inline constexpr std::size_t kDeepestNesting = 8;
inline constexpr unsigned kMostPasses = 1'000'000;
inline constexpr std::size_t kMostPoints = 100'000;
inline constexpr std::chrono::hours kLongestTime{168};
inline constexpr std::chrono::milliseconds kPollInterval{100};  ///< between two questions of an expectation

/// One thing that a scenario does. Values for the instrument are 8-bit Windows-1252, everything else is UTF-8.
struct Action {
    enum class Kind {
        Send,    ///< `settings`, in their order
        Wait,    ///< `time`
        Expect,  ///< `expected`, each met within `time`
        Sweep,   ///< `key` takes one of `points` after the other; `actions` at each, which lasts `time` at least
        Repeat,  ///< `actions`, as often as `passes` says
        TrafficMessage,  ///< the group code `text` with its announcement
        Pause,           ///< shows `text`, waits for a person's Return
        Note,            ///< `text` for the report
    };
    /// A question by its name and what it should be answered with; several values where it has several answers.
    struct Expectation {
        std::string name;
        std::vector<std::string> values;
    };

    Kind kind = Kind::Note;
    std::vector<std::pair<std::string, std::string>> settings = {};
    std::vector<Expectation> expected = {};
    std::chrono::milliseconds time{0};
    std::string text = {};
    std::string key = {};
    std::vector<std::string> points = {};
    unsigned passes = 0;
    bool untilReturn = false;  ///< a sweep or a repetition ends when a person presses Return
    std::vector<Action> actions = {};
};

/// What is to be sent, waited for and looked at, one after the other.
struct Scenario {
    std::string title;
    std::optional<int> dataSet;  ///< sent first, as at the opening of a session
    std::vector<Action> actions;
    bool restore = false;  ///< afterwards what stood before comes back
    std::string report;    ///< the file that keeps what happened; "" for none
};

/// How often a sweep or a repetition goes through its actions at most; 0 for every other kind.
[[nodiscard]] std::size_t passesOf(const Action& action);

/// What a step sends or expects, as "PS=MESSTURM TP=1".
[[nodiscard]] std::string listed(const Action& action);

/// The action in a few words, as "send PS=MESSTURM TP=1".
[[nodiscard]] std::string describe(const Action& action);

}  // namespace kdx::scenario
