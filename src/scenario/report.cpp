#include "scenario/report.h"

#include <algorithm>
#include <fstream>
#include <string_view>

#include "base/clock.h"
#include "base/numbers.h"
#include "settings/durablefile.h"

namespace kdx::scenario {

namespace {

std::string field(std::string_view text) {
    if (text.find_first_of(",\"\r\n") == std::string_view::npos) return std::string(text);
    std::string quoted = "\"";
    for (const char character : text) quoted.append(character == '"' ? 2 : 1, character);
    return quoted + "\"";
}

}  // namespace

std::string dateAndTime(const Clock& clock) {
    // The day is asked before and after: over midnight it must be the one that the seconds belong to.
    Date today = clock.today();
    double seconds = clock.secondsSinceMidnight();
    if (const Date after = clock.today(); after.day != today.day) {
        today = after;
        seconds = clock.secondsSinceMidnight();
    }
    // The clock's seconds are sums of fractions, so that a whole millisecond may lie a little below itself.
    constexpr int kLastOfDay = 24 * 3600 * 1000 - 1;
    const int milliseconds = std::min(static_cast<int>(seconds * 1000 + 0.001), kLastOfDay);
    const int whole = milliseconds / 1000;
    return std::to_string(today.year) + "-" + twoDigits(today.month) + "-" + twoDigits(today.day) + " " +
           timeText(std::chrono::seconds(whole)) + "." + rightmost("00" + std::to_string(milliseconds % 1000), 3);
}

std::string csvLine(const Row& row) {
    std::string line = field(row.time);
    for (const std::string* text : {&row.step, &row.key, &row.value, &row.command, &row.status, &row.answer})
        line.append(",").append(field(*text));
    return line + "\r\n";
}

std::string faultWords(ReportFault fault) {
    return fault == ReportFault::Foreign ? "is there, and is no report that could be written anew"
                                         : "cannot be written";
}

std::optional<ReportFault> Report::begin() const {
    const Row columns{"time", "step", "key", "value", "command", "status", "answer"};
    std::string there(csvLine(columns).size(), '\0');
    std::ifstream file;
    std::error_code error;
    if (std::filesystem::is_regular_file(m_file, error)) file.open(m_file, std::ios::binary);
    file.read(there.data(), static_cast<std::streamsize>(there.size()));
    const bool isEmpty = file.gcount() == 0;
    if (!isEmpty && there != csvLine(columns)) return ReportFault::Foreign;
    if (!emptyPlainFile(m_file) || !add(columns)) return ReportFault::Unwritable;
    return std::nullopt;
}

bool Report::add(const Row& row) const {
    return appendToPlainFile(m_file, csvLine(row));
}

}  // namespace kdx::scenario
