#include "scenario/stepreader.h"

#include <array>
#include <span>

#include "base/numbers.h"
#include "coder/keyfacts.h"
#include "scenario/decimal.h"
#include "scenario/questions.h"
#include "tmc/groupcode.h"

namespace kdx::scenario {

namespace {

using Kind = Action::Kind;
using Words = std::span<const std::string_view>;

constexpr std::array<std::string_view, 6> kBesideSweep = {"from", "to", "step", "points", "dwell", "steps"};
constexpr std::array<std::string_view, 1> kBesideRepeat = {"steps"};
constexpr std::string_view kUntil = "until";  // beside both
constexpr std::string_view kWithin = "within";

/// The word that says what a step does.
struct KindWord {
    std::string_view word;
    Kind kind;
    Words beside = {};
};
constexpr std::array kKinds = {KindWord{"send", Kind::Send},
                               KindWord{"wait", Kind::Wait},
                               KindWord{"expect", Kind::Expect},
                               KindWord{"sweep", Kind::Sweep, kBesideSweep},
                               KindWord{"repeat", Kind::Repeat, kBesideRepeat},
                               KindWord{"tmc", Kind::TrafficMessage},
                               KindWord{"pause", Kind::Pause},
                               KindWord{"note", Kind::Note}};

const KindWord* kindOf(std::string_view word) {
    const auto* const found =
        std::find_if(kKinds.begin(), kKinds.end(), [word](const KindWord& kind) { return kind.word == word; });
    return found == kKinds.end() ? nullptr : found;
}

std::vector<std::string_view> kindWords() {
    std::vector<std::string_view> words(kKinds.size());
    std::transform(kKinds.begin(), kKinds.end(), words.begin(), [](const KindWord& kind) { return kind.word; });
    return words;
}

std::vector<std::string_view> wordsBeside(const KindWord& kind) {
    std::vector<std::string_view> words{kind.word};
    words.insert(words.end(), kind.beside.begin(), kind.beside.end());
    if (!kind.beside.empty()) words.push_back(kUntil);
    return words;
}

}  // namespace

const YamlNode* memberOf(const YamlNode& map, std::string_view name) {
    const auto found = std::find_if(map.members.begin(), map.members.end(),
                                    [name](const auto& member) { return member.first.text == name; });
    return found == map.members.end() ? nullptr : &found->second;
}

std::vector<Action> StepReader::steps(const YamlNode& list) {
    std::vector<Action> actions;
    if (list.kind != YamlNode::Kind::List) {
        m_values.wrong(list, Mistake::NoList);
    } else if (list.items.empty()) {
        m_values.wrong(list, Mistake::EmptyList);
    } else if (m_depth >= kDeepestNesting) {
        m_values.wrong(list, Mistake::Nesting, {std::to_string(kDeepestNesting)});
    } else {
        ++m_depth;
        for (const YamlNode& item : list.items) actions.push_back(step(item));
        --m_depth;
    }
    return actions;
}

Action StepReader::step(const YamlNode& node) {
    Action action;
    if (node.kind != YamlNode::Kind::Map || node.members.empty()) {
        m_values.wrong(node, Mistake::NoStep);
        return action;
    }
    const auto said = std::find_if(node.members.begin(), node.members.end(),
                                   [](const auto& member) { return kindOf(member.first.text) != nullptr; });
    if (said == node.members.end()) {
        const YamlNode& first = node.members.front().first;
        m_values.wrong(first, Mistake::UnknownWord, {first.text, listed(kindWords())});
        return action;
    }
    const KindWord& kind = *kindOf(said->first.text);
    for (const auto& [name, value] : node.members) {
        if (kindOf(name.text) != nullptr && name.text != kind.word) {
            m_values.wrong(name, Mistake::TwoThings, {name.text});
        } else if (const auto words = wordsBeside(kind); !isOneOf(words, name.text)) {
            m_values.wrong(name, Mistake::UnknownWord, {name.text, listed(words)});
        }
    }
    const YamlNode& value = said->second;
    action.kind = kind.kind;
    switch (kind.kind) {
        case Kind::Send:
            send(value, action);
            break;
        case Kind::Wait:
            action.time = m_values.time(value, kind.word).value_or(action.time);
            break;
        case Kind::Expect:
            expect(value, action);
            break;
        case Kind::Sweep:
            sweep(node, value, action);
            break;
        case Kind::Repeat:
            repeat(node, value, action);
            break;
        case Kind::TrafficMessage:
            message(value, action);
            break;
        case Kind::Pause:
        case Kind::Note:
            action.text = m_values.text(value, kind.word).value_or("");
            break;
    }
    return action;
}

bool StepReader::isNames(const YamlNode& node, std::string_view word, std::string_view example) {
    if (node.kind == YamlNode::Kind::Map && !node.members.empty()) return true;
    m_values.wrong(node, Mistake::NoNames, {std::string(word), std::string(example)});
    return false;
}

void StepReader::send(const YamlNode& map, Action& action) {
    if (!isNames(map, "send", "send: {PS: MESSTURM, TP: 1}")) return;
    for (const auto& [name, value] : map.members) {
        if (factsOf(name.text) == nullptr) {
            m_values.wrong(name, Mistake::NoSuchKey, {name.text});
        } else if (const auto legal = m_values.keyValue(value, name.text)) {
            action.settings.emplace_back(name.text, *legal);
        }
    }
}

void StepReader::expect(const YamlNode& map, Action& action) {
    if (!isNames(map, "expect", R"(expect: {TA: "1", within: 1 s})")) return;
    for (const auto& [name, value] : map.members) {
        if (name.text == kWithin) {
            action.time = m_values.time(value, kWithin).value_or(action.time);
        } else {
            expectation(name.text, name, value, action);
        }
    }
    if (map.members.size() == 1 && map.members.front().first.text == kWithin)
        m_values.wrong(map, Mistake::NothingExpected);
}

void StepReader::expectation(const std::string& name, const YamlNode& at, const YamlNode& value, Action& action) {
    const auto question = questionOf(name, {});
    if (!question) {
        m_values.wrong(at, Mistake::NoQuestion, {name});
        return;
    }
    const std::size_t wanted = question->queries.size();
    const std::span<const YamlNode> given =
        value.kind == YamlNode::Kind::List ? std::span(value.items) : std::span(&value, 1);
    if (given.size() != wanted) {
        m_values.wrong(value, wanted == 1 ? Mistake::OneAnswer : Mistake::Answers,
                       {name, std::to_string(wanted), std::to_string(given.size())});
        return;
    }
    Action::Expectation expectation{name, {}};
    for (const YamlNode& one : given) expectation.values.push_back(m_values.instrumentText(one, name).value_or(""));
    action.expected.push_back(std::move(expectation));
}

void StepReader::sweep(const YamlNode& node, const YamlNode& key, Action& action) {
    const auto name = m_values.text(key, "sweep");
    const KeyFacts* facts = name ? factsOf(*name) : nullptr;
    if (name && facts == nullptr) {
        m_values.wrong(key, Mistake::NoSuchKey, {*name});
    } else if (name && !facts->isNumber) {
        m_values.wrong(key, Mistake::NoNumberToSweep, {*name});
    } else if (name) {
        action.key = *name;
    }
    pointsOf(node, action);
    if (const YamlNode* dwell = memberOf(node, "dwell"))
        action.time = m_values.time(*dwell, "dwell").value_or(action.time);
    if (memberOf(node, "dwell") == nullptr && memberOf(node, "steps") == nullptr) m_values.wrong(node, Mistake::NoPace);
    loop(node, action);
}

void StepReader::pointsOf(const YamlNode& node, Action& action) {
    const YamlNode* points = memberOf(node, "points");
    const bool ranged =
        memberOf(node, "from") != nullptr || memberOf(node, "to") != nullptr || memberOf(node, "step") != nullptr;
    if (points == nullptr) {
        range(node, action);
    } else if (ranged) {
        m_values.wrong(*points, Mistake::PointsAndRange);
    } else if (points->kind != YamlNode::Kind::List || points->items.empty()) {
        m_values.wrong(*points, Mistake::NoPoints);
    } else if (points->items.size() > kMostPoints) {
        m_values.wrong(*points, Mistake::MostPoints, {std::to_string(kMostPoints)});
    } else if (fits(*points, points->items.size())) {
        for (const YamlNode& point : points->items) {
            const auto number = m_values.number(point, kPointName);
            if (number && (action.key.empty() || m_values.isLegal(point, action.key, point.text)))
                action.points.push_back(point.text);
        }
    }
}

bool StepReader::fits(const YamlNode& node, std::size_t points) {
    m_points += points;
    if (m_points <= kMostPoints) return true;
    m_values.wrong(node, Mistake::MostPointsOfAll, {std::to_string(kMostPoints)});
    return false;
}

void StepReader::range(const YamlNode& node, Action& action) {
    const YamlNode* const from = memberOf(node, "from");
    const YamlNode* const to = memberOf(node, "to");
    const YamlNode* const step = memberOf(node, "step");
    if (from == nullptr || to == nullptr || step == nullptr) {
        m_values.wrong(node, Mistake::NoRange);
        return;
    }
    const auto first = m_values.number(*from, "from");
    const auto last = m_values.number(*to, "to");
    const auto one = m_values.number(*step, "step");
    if (!first || !last || !one) return;
    const bool upwards = last->millionths > first->millionths;
    if (one->millionths == 0) {
        m_values.wrong(*step, Mistake::StepZero);
    } else if (*first != *last && upwards != (one->millionths > 0)) {
        m_values.wrong(*step, upwards ? Mistake::StepUpwards : Mistake::StepDownwards, {from->text, to->text});
    } else if (countPoints(*first, *last, *one) > kMostPoints) {
        m_values.wrong(*step, Mistake::TooManyPoints,
                       {std::to_string(kMostPoints), std::to_string(countPoints(*first, *last, *one))});
    } else if (action.key.empty() || (m_values.isLegal(*from, action.key, decimalText(*first)) &&
                                      m_values.isLegal(*to, action.key, decimalText(*last)))) {
        if (fits(*step, countPoints(*first, *last, *one))) action.points = sweepPoints(*first, *last, *one);
        // Between legal ends a point can only be wrong by its decimals, which the key may not take.
        if (action.key.empty() || action.points.size() < 2) return;
        (void)m_values.isLegal(*step, action.key, action.points[1]);
    }
}

void StepReader::repeat(const YamlNode& node, const YamlNode& count, Action& action) {
    action.passes = m_values.whole(count, "repeat", 1, kMostPasses).value_or(1);
    if (memberOf(node, "steps") == nullptr) m_values.wrong(node, Mistake::NothingToRepeat);
    loop(node, action);
}

void StepReader::loop(const YamlNode& node, Action& action) {
    if (const YamlNode* list = memberOf(node, "steps")) action.actions = steps(*list);
    const YamlNode* until = memberOf(node, kUntil);
    if (until == nullptr) return;
    const auto what = m_values.text(*until, kUntil);
    action.untilReturn = what == "Return";
    if (what && !action.untilReturn) m_values.wrong(*until, Mistake::Until, {*what});
}

void StepReader::message(const YamlNode& code, Action& action) {
    const auto digits = m_values.text(code, "tmc");
    if (!digits) return;
    action.text = *digits;
    if (digits->size() != kGroupCodeLength || !isHex(*digits) || digits->front() > '1') {
        m_values.wrong(code, Mistake::NoMessage, {*digits});
    }
}

}  // namespace kdx::scenario
