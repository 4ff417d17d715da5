#include "coder/loggedcommands.h"

#include <algorithm>

#include "coder/sendparam.h"

namespace kdx {

namespace {

constexpr std::size_t kKeyWidth = 15;
constexpr std::string_view kAfterKey = "= ";
constexpr std::string_view kAnswer = "Answer \"";
constexpr std::string_view kLineEnd = "\r\n";

/// Takes the first line off the log, without its end.
std::string_view takeLine(std::string_view& log) {
    const std::size_t end = log.find(kLineEnd);
    const std::string_view line = log.substr(0, end);
    log.remove_prefix(end == std::string_view::npos ? log.size() : end + kLineEnd.size());
    return line;
}

/// The blanks behind a quoted answer that came with a carriage return.
bool isEndOfAnswer(std::string_view line) {
    return !line.empty() && line.find_first_not_of(' ') == line.size() - 1 && line.back() == '"';
}

}  // namespace

LoggedCommands readLoggedCommands(std::string_view log) {
    LoggedCommands logged;
    for (std::size_t number = 1; !log.empty(); ++number) {
        const std::string_view line = takeLine(log);
        if (line.size() < kKeyWidth || !line.substr(kKeyWidth).starts_with(kAfterKey)) {
            logged.unreadableLines.push_back(number);
            continue;
        }
        std::string_view key = line.substr(0, kKeyWidth);
        key.remove_prefix(std::min(key.find_first_not_of(' '), key.size()));
        std::string_view rest = line.substr(kKeyWidth + kAfterKey.size());
        if (rest.starts_with(kAnswer)) {
            // An answer is logged as it came, its line end in the middle of the blanks that fill it up.
            for (; !rest.ends_with('"') && !log.empty(); ++number) rest = takeLine(log);
            if (std::string_view after = log; isEndOfAnswer(takeLine(after))) {
                log = after;
                ++number;
            }
            continue;
        }
        // Only what was sent has an empty value and a note.
        if (rest.size() < 2 || rest.front() != '"' || rest.back() != '"') continue;
        const auto& command = logged.commands.emplace_back(key, rest.substr(1, rest.size() - 2)).second;
        if (endsItsTextEarly(command)) logged.quotedLines.push_back(number);
    }
    return logged;
}

}  // namespace kdx
