#include "coder/loggedcommands.h"

#include <algorithm>
#include <optional>

#include "coder/sendparam.h"

namespace kdx {

namespace {

constexpr std::size_t kKeyWidth = 15;
constexpr std::string_view kAfterKey = "= ";
constexpr std::string_view kAnswer = "Answer \"";
/// Takes the first line off the log, without its end: CR LF as the program writes it, LF as editors make of it.
std::string_view takeLine(std::string_view& log) {
    const std::size_t end = log.find('\n');
    std::string_view line = log.substr(0, end);
    log.remove_prefix(end == std::string_view::npos ? log.size() : end + 1);
    if (line.ends_with('\r')) line.remove_suffix(1);
    return line;
}

bool isLogLine(std::string_view line) {
    return line.size() >= kKeyWidth && line.substr(kKeyWidth).starts_with(kAfterKey);
}

/// The blanks behind a quoted answer that came with a line end.
bool isEndOfAnswer(std::string_view line) {
    return !line.empty() && line.find_first_not_of(' ') == line.size() - 1 && line.back() == '"';
}

/// How many further lines of the log belong to an answer, which is logged as it came, its line end in the middle of the
/// blanks that fill it up; nothing when it does not end before the next line begins.
std::optional<std::size_t> furtherLines(std::string_view answer, std::string_view log) {
    std::size_t count = 0;
    for (bool ended = answer.size() > kAnswer.size() && answer.ends_with('"'); !ended; ++count) {
        const std::string_view line = takeLine(log);
        if (isLogLine(line) || (line.empty() && log.empty())) return std::nullopt;
        ended = line.ends_with('"');
    }
    return isEndOfAnswer(takeLine(log)) ? count + 1 : count;
}

/// Whether what stands behind the key of a line that begins with a quote is a whole command.
bool isWholeCommand(std::string_view rest) {
    return rest.size() >= 2 && rest.ends_with('"') && !leavesItsTextOpen(rest.substr(1, rest.size() - 2));
}

}  // namespace

LoggedCommands readLoggedCommands(std::string_view log) {
    LoggedCommands logged;
    for (std::size_t number = 1; !log.empty(); ++number) {
        const bool ended = log.find('\n') != std::string_view::npos;
        const std::string_view line = takeLine(log);
        if (!isLogLine(line)) {
            logged.unreadableLines.push_back(number);
            continue;
        }
        std::string_view key = line.substr(0, kKeyWidth);
        key.remove_prefix(std::min(key.find_first_not_of(' '), key.size()));
        const std::string_view rest = line.substr(kKeyWidth + kAfterKey.size());
        if (rest.starts_with(kAnswer)) {
            const auto further = furtherLines(rest, log);
            if (!further) logged.unreadableLines.push_back(number);
            for (std::size_t i = 0; i < further.value_or(0); ++i, ++number) (void)takeLine(log);
        } else if (rest.empty() && !ended) {
            logged.unreadableLines.push_back(number);  // cut before what was sent
        } else if (rest.starts_with('"')) {
            // Only what was sent has an empty value and a note.
            if (!isWholeCommand(rest)) {
                logged.unreadableLines.push_back(number);
                continue;
            }
            const auto& command = logged.commands.emplace_back(key, rest.substr(1, rest.size() - 2)).second;
            if (endsItsTextEarly(command)) logged.quotedLines.push_back(number);
        }
    }
    return logged;
}

}  // namespace kdx
