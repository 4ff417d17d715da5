#pragma once

#include <cstddef>
#include <deque>
#include <optional>
#include <string>
#include <string_view>

namespace kdx::sim {

/// Error numbers of the SCPI standard that the virtual instrument reports.
enum class ScpiError : int {
    None = 0,
    InvalidSeparator = -103,
    ParameterNotAllowed = -108,
    MissingParameter = -109,
    UndefinedHeader = -113,
    InvalidSuffix = -131,
    InvalidString = -151,
    SettingsConflict = -221,
    OutOfRange = -222,
    TooMuchData = -223,
    IllegalValue = -224,
    QueueOverflow = -350,
    InputBufferOverrun = -363,
    QueryInterrupted = -410,
    QueryUnterminated = -420,
    QueryDeadlocked = -430,
};

/// The standard's words for an error.
[[nodiscard]] std::string_view errorText(ScpiError error);
/// The error as the instrument tells it: its number, a comma and its text in double quotes.
[[nodiscard]] std::string errorAnswer(ScpiError error);

/// What one command comes to: an error, or an answer to a query (without quotes and line end), or neither.
struct Reply {
    ScpiError error = ScpiError::None;
    std::optional<std::string> answer;
};

/// The instrument's errors in the order they occurred. When it is full its last entry becomes "Queue overflow" and
/// further errors are dropped, as SCPI wants it.
class ErrorQueue {
public:
    static constexpr std::size_t kCapacity = 32;

    void push(ScpiError error);
    /// Takes the oldest error out and tells it; 0,"No error" when there is none.
    std::string pop();
    void clear() { m_errors.clear(); }
    [[nodiscard]] bool empty() const { return m_errors.empty(); }

private:
    std::deque<ScpiError> m_errors;
};

}  // namespace kdx::sim
