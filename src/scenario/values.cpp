#include "scenario/values.h"

#include <algorithm>

#include "base/codepage.h"
#include "base/duration.h"
#include "base/numbers.h"
#include "base/printable.h"
#include "coder/keyfacts.h"
#include "scenario/scenario.h"

namespace kdx::scenario {

std::optional<std::string> Values::text(const YamlNode& node, std::string_view name) {
    const std::string subject(name);
    if (node.kind == YamlNode::Kind::Nothing) {
        wrong(node, Mistake::NoValue, {subject});
        return std::nullopt;
    }
    if (node.kind != YamlNode::Kind::Text) {
        wrong(node, Mistake::OneValue, {subject});
        return std::nullopt;
    }
    std::string text = node.text;
    if (text.ends_with('\n')) text.pop_back();  // a text over several lines ends so
    if (std::any_of(text.begin(), text.end(), isControl)) {
        wrong(node, Mistake::ControlInText, {subject});
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
    m_problems.add(literal ? node.at + at : node.at, Mistake::NoCharacter,
                   {std::string(name), noSuchCharacter(foreign), std::string(foreign)});
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
        wrong(node, unitMissing ? Mistake::NoUnit : Mistake::NoTime, {std::string(name), *written});
    } else if (time->count() < 1 || *time > kLongestTime) {
        wrong(node, Mistake::TimeLimits, {std::string(name), *written});
    } else {
        return time;
    }
    return std::nullopt;
}

std::optional<unsigned> Values::whole(const YamlNode& node, std::string_view name, unsigned lowest, unsigned highest) {
    const auto written = text(node, name);
    if (!written) return std::nullopt;
    const auto value = isDecimal(*written) ? readDecimal(*written) : std::nullopt;
    if (value && value->millionths >= lowest * Decimal::kOne && value->millionths <= highest * Decimal::kOne)
        return static_cast<unsigned>(value->millionths / Decimal::kOne);
    wrong(node, Mistake::NoWhole, {std::string(name), std::to_string(lowest), std::to_string(highest), *written});
    return std::nullopt;
}

std::optional<bool> Values::choice(const YamlNode& node, std::string_view name) {
    const auto written = text(node, name);
    if (!written) return std::nullopt;
    if (*written == "true" || *written == "false") return *written == "true";
    wrong(node, Mistake::NoChoice, {std::string(name), *written});
    return std::nullopt;
}

std::optional<Decimal> Values::number(const YamlNode& node, std::string_view name) {
    const auto written = text(node, name);
    if (!written) return std::nullopt;
    const auto value = readDecimal(*written);
    if (!value) {
        const bool comma = written->find(',') != std::string::npos;
        wrong(node, comma ? Mistake::Comma : Mistake::NoNumber, {std::string(name), *written});
    }
    return value;
}

bool Values::isLegal(const YamlNode& node, const std::string& key, const std::string& value) {
    if (m_force) return true;
    const auto why = wrongValue(key, value, m_corrections);
    if (why) wrong(node, Mistake::Value, {key, toUtf8(value), *why});
    return !why;
}

}  // namespace kdx::scenario
