#include "sim/scpi.h"

#include <algorithm>
#include <charconv>
#include <limits>

#include "base/codepage.h"
#include "base/numbers.h"

namespace kdx::sim {

namespace {

// IEEE 488.2 counts the blank and every control character as white space (the line feed is gone before).
bool isWhite(char c) {
    return static_cast<unsigned char>(c) <= 0x20;
}

bool isOfHeader(char c) {
    return (c >= 'A' && c <= 'Z') || (c >= 'a' && c <= 'z') || (c >= '0' && c <= '9') || c == '_' || c == ':' ||
           c == '*';
}

// Where the string that the parameter begins with ends: behind its closing quote; npos when it never closes.
std::size_t endOfString(std::string_view parameter) {
    const char quote = parameter.front();
    for (std::size_t at = 1; at < parameter.size(); ++at) {
        if (parameter[at] != quote) continue;
        if (at + 1 == parameter.size() || parameter[at + 1] != quote) return at + 1;
        ++at;  // the second of a doubled quote
    }
    return std::string_view::npos;
}

bool beginsString(std::string_view parameter) {
    return !parameter.empty() && (parameter.front() == '"' || parameter.front() == '\'');
}

}  // namespace

bool Quotes::take(char c) {
    if (m_open == '\0') {
        if (c == '"' || c == '\'') m_open = c;
    } else if (c == m_open) {
        m_open = '\0';
    }
    return m_open != '\0';
}

std::vector<std::string_view> splitOutsideQuotes(std::string_view text, char separator) {
    std::vector<std::string_view> pieces;
    std::size_t start = 0;
    Quotes quotes;
    for (std::size_t i = 0; i < text.size(); ++i) {
        if (quotes.take(text[i]) || text[i] != separator) continue;
        pieces.push_back(text.substr(start, i - start));
        start = i + 1;
    }
    pieces.push_back(text.substr(start));
    return pieces;
}

HeadAndTail cutAt(std::string_view text, char separator) {
    const std::size_t position = text.find(separator);
    if (position == std::string_view::npos) return {text, std::nullopt};
    return {text.substr(0, position), text.substr(position + 1)};
}

std::string_view trimmed(std::string_view text) {
    while (!text.empty() && isWhite(text.front())) text.remove_prefix(1);
    while (!text.empty() && isWhite(text.back())) text.remove_suffix(1);
    return text;
}

CommandUnit readUnit(std::string_view unit) {
    unit = trimmed(unit);
    const auto end = std::find_if_not(unit.begin(), unit.end(), isOfHeader);
    CommandUnit result;
    result.header = unit.substr(0, static_cast<std::size_t>(end - unit.begin()));
    std::string_view rest = unit.substr(result.header.size());
    result.query = !rest.empty() && rest.front() == '?';
    if (result.query) rest.remove_prefix(1);
    result.separated = rest.empty() || isWhite(rest.front());
    result.parameter = trimmed(rest);
    return result;
}

bool wordMatches(std::string_view pattern, std::string_view word) {
    const auto shortEnd = std::find_if(pattern.begin(), pattern.end(), [](char c) { return c >= 'a' && c <= 'z'; });
    const auto shortLength = static_cast<std::size_t>(shortEnd - pattern.begin());
    return equalNoCase(word, pattern) || equalNoCase(word, pattern.substr(0, shortLength));
}

bool headerMatches(std::string_view pattern, std::string_view header) {
    if (!header.empty() && header.front() == ':') header.remove_prefix(1);
    for (;;) {
        const auto [patternWord, patternRest] = cutAt(pattern, ':');
        const auto [headerWord, headerRest] = cutAt(header, ':');
        if (!wordMatches(patternWord, headerWord)) return false;
        if (!patternRest || !headerRest) return !patternRest && !headerRest;
        pattern = *patternRest;
        header = *headerRest;
    }
}

ScpiError checkOneParameter(const CommandUnit& unit) {
    if (!unit.separated) return ScpiError::InvalidSeparator;
    const bool several = splitOutsideQuotes(unit.parameter, ',').size() > 1;
    return several ? ScpiError::ParameterNotAllowed : ScpiError::None;
}

ScpiError errorOfValue(std::string_view parameter) {
    const bool two = std::any_of(parameter.begin(), parameter.end(), [](char c) { return isWhite(c) || c == ':'; });
    return two ? ScpiError::InvalidSeparator : ScpiError::IllegalValue;
}

ScpiError errorOfSuffix(std::string_view suffix) {
    const bool another = isDecimal(suffix.substr(0, 1)) || errorOfValue(suffix) == ScpiError::InvalidSeparator;
    return another ? ScpiError::InvalidSeparator : ScpiError::InvalidSuffix;
}

ScpiError errorOfString(std::string_view parameter) {
    if (!beginsString(parameter)) return ScpiError::InvalidString;
    const std::size_t end = endOfString(parameter);
    if (end == std::string_view::npos || parameter.substr(end).find(parameter.front()) != std::string_view::npos) {
        return ScpiError::InvalidString;
    }
    return ScpiError::InvalidSeparator;
}

std::optional<std::string> unquoted(std::string_view parameter) {
    if (!beginsString(parameter) || endOfString(parameter) != parameter.size()) return std::nullopt;
    const char quote = parameter.front();
    const std::string_view inner = parameter.substr(1, parameter.size() - 2);
    std::string text;
    for (std::size_t at = 0; at < inner.size(); ++at) {
        text += inner[at];
        if (inner[at] == quote) ++at;  // the second of a doubled quote
    }
    return text;
}

std::string quoted(std::string_view text) {
    std::string result = "\"";
    for (const char c : text) {
        if (c == '"') result += '"';
        result += c;
    }
    return result + '"';
}

std::optional<NumberWithSuffix> readNumber(std::string_view text) {
    text = trimmed(text);
    const bool negative = text.starts_with('-');
    const std::string_view digits = text.substr(negative || text.starts_with('+') ? 1 : 0);
    // from_chars would take "inf" and "nan" too.
    if (digits.empty() || (!isDecimal(digits.substr(0, 1)) && digits.front() != '.')) return std::nullopt;
    NumberWithSuffix number;
    const auto result = std::from_chars(digits.data(), digits.data() + digits.size(), number.value);
    if (result.ec == std::errc::invalid_argument) return std::nullopt;
    if (result.ec == std::errc::result_out_of_range) number.value = leadingNumber(digits);  // 0 or infinite
    if (negative) number.value = -number.value;
    number.suffix = trimmed(digits.substr(static_cast<std::size_t>(result.ptr - digits.data())));
    return number;
}

std::optional<int> readWhole(std::string_view text) {
    text = trimmed(text);
    int value = 0;
    const auto result = std::from_chars(text.data(), text.data() + text.size(), value);
    if (result.ptr != text.data() + text.size() || result.ec == std::errc::invalid_argument) return std::nullopt;
    // All digits, yet too many of them: a number, and outside every range.
    if (result.ec == std::errc::result_out_of_range) return std::numeric_limits<int>::max();
    return value;
}

bool hasControlCharacter(std::string_view text) {
    return std::any_of(text.begin(), text.end(), [](char c) { return static_cast<unsigned char>(c) < 0x20; });
}

}  // namespace kdx::sim
