#pragma once

#include <filesystem>
#include <optional>
#include <string>

namespace kdx {
class Clock;
}

namespace kdx::scenario {

/// What happened, as a row of the report. Texts are UTF-8.
struct Row {
    std::string time;     ///< of the PC clock, with milliseconds
    std::string step;     ///< its number
    std::string key;      ///< or the name that was asked
    std::string value;    ///< that was sent or expected, that a loop had come to at Return; a text
    std::string command;  ///< as it went out; the questions of an expectation
    std::string status;   ///< of the VISA library, 0 when all is well; or a word
    std::string answer;
};
// Statuses, and keys where there is none of the key table.
inline constexpr const char* kMet = "met";
inline constexpr const char* kNotMet = "not met";
inline constexpr const char* kCutOff = "stopped";
inline constexpr const char* kReturn = "Return";
inline constexpr const char* kNoReturn = "no Return";
inline constexpr const char* kGoesOn = "--yes";
inline constexpr const char* kPauseRow = "pause";
inline constexpr const char* kNoteRow = "note";
inline constexpr const char* kRepeatRow = "repeat";
// Steps of what belongs to none.
inline constexpr const char* kOpening = "data_set";
inline constexpr const char* kRestoring = "restore";

/// The clock's date and time of day as "2009-03-05 12:00:00.250".
[[nodiscard]] std::string dateAndTime(const Clock& clock);

/// The fields as a line of a CSV file (RFC 4180), its end included.
[[nodiscard]] std::string csvLine(const Row& row);

/// Why a report cannot be begun.
enum class ReportFault {
    Foreign,  ///< the file is there, and is no report
    Unwritable,
};

/// The same in words of kdx-ctl, which follow the file's name.
[[nodiscard]] std::string faultWords(ReportFault fault);

/// A CSV file of rows. Each is in the file before anything else happens, so that a run that is cut off has left all it
/// did. Only a plain file is written.
class Report {
public:
    explicit Report(std::filesystem::path file) : m_file(std::move(file)) {}

    /// Begins the file anew with the names of the columns. A file that is there and is no report stays as it is.
    /// @returns why it cannot be done; nothing when it is.
    [[nodiscard]] std::optional<ReportFault> begin() const;
    /// False when the row is not in the file, or in part only.
    [[nodiscard]] bool add(const Row& row) const;
    [[nodiscard]] const std::filesystem::path& file() const { return m_file; }

private:
    std::filesystem::path m_file;
};

}  // namespace kdx::scenario
