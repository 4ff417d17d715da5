#include "air/shadow.h"

#include <algorithm>
#include <utility>

#include "base/clock.h"
#include "base/codepage.h"
#include "base/printable.h"
#include "sim/scpi.h"

namespace kdx::air {

namespace {

using namespace std::chrono_literals;

constexpr Ticks kLongestGap{20s};
constexpr std::size_t kForgottenAfter = Ticks{5s} / kGroupTime;
// Announcements of other networks that were not sent when they were due are over: eight groups a network, and there is
// room for eleven.
constexpr int kOverdueGroups = 8 * 11;

constexpr std::size_t kMostRefusals = 100;

/// What a command is about.
struct Subject {
    std::string setting;  ///< the coder's own name of it, with the network that it is of, or all before the value
    bool adds = false;    ///< to what the setting has: the lists "AF=+," and "EON-AFB=" with it
};

Subject subjectOf(std::string_view command) {
    const auto quote = command.find('"');
    if (quote == std::string_view::npos) return {std::string(command.substr(0, command.find(' '))), false};
    command.remove_prefix(quote + 1);
    const auto equals = command.find('=');
    Subject subject{std::string(command.substr(0, equals)), false};
    if (equals == std::string_view::npos) return subject;
    std::string_view value = command.substr(equals + 1);
    const auto comma = value.find(',');
    if (subject.setting.starts_with("EON-") && comma != std::string_view::npos) {
        subject.setting += ' ' + upperCase(value.substr(0, comma));
        value.remove_prefix(comma + 1);
    }
    subject.adds = value.starts_with('+');
    return subject;
}

GroupType typeOf(const Group& group) {
    return static_cast<GroupType>(group.blocks[1] >> 11U);
}

}  // namespace

Shadow::Shadow(const Clock& clock) : m_clock(clock), m_instrument(clock), m_time(airTimeOf(clock)) {
    m_instrument.onUnit([this](const sim::CommandUnit&, sim::ScpiError error) {
        if (error == sim::ScpiError::None) return;
        m_isRefused = true;
        refuse("refused: " + toUtf8(printableLine(m_message, '.')) + " (" + sim::errorAnswer(error) + ")");
    });
}

void Shadow::take(std::string_view command) {
    if (m_watched) catchUp();
    m_message = command;
    m_isRefused = false;
    m_instrument.execute(command);
    if (!m_isRefused) forgetRefused();
    m_composer.take(m_instrument.transmission());
    m_settings.reset();
    ++m_commands;
    if (m_watched) return;
    m_time = airTimeOf(m_clock);
    m_stale = true;
}

void Shadow::catchUp() {
    const AirTime now = airTimeOf(m_clock);
    const bool isSetBack = now + kGroupTime < m_time;
    if (isSetBack || now - m_time > kLongestGap) {
        begin(isSetBack ? now : now - kLongestGap);
    } else if (m_stale) {
        begin(m_time);
    }
    while (m_time + kGroupTime <= now) sendOne();
}

void Shadow::begin(AirTime from) {
    m_stale = false;
    m_time = from;
    m_radio = Receiver();
    m_sent.clear();
    m_types.clear();
    for (int i = 0; i < kOverdueGroups; ++i) (void)m_composer.next(from);
}

void Shadow::sendOne() {
    if (!m_settings) m_settings = std::make_shared<sim::InstrumentSettings>(m_instrument.transmission().settings);
    const OnAir what = m_composer.next(m_time);
    m_time += kGroupTime;
    ++m_count;
    m_sent.push_back({what, m_time, m_settings});
    count(m_sent.back(), true);
    if (m_sent.size() > kMostKept) {
        count(m_sent.front(), false);
        m_sent.pop_front();
    }
    if (what.kind != OnAir::Kind::Group) {
        if (++m_silence == kForgottenAfter) m_radio = Receiver();
        return;
    }
    m_silence = 0;
    ReceivedGroup group;
    for (std::size_t i = 0; i < group.blocks.size(); ++i) group.blocks.at(i) = what.group.blocks.at(i);
    m_radio.take(group);
}

void Shadow::count(const Sent& sent, bool comes) {
    if (sent.what.kind != OnAir::Kind::Group) return;
    const auto type = m_types.try_emplace(typeOf(sent.what.group)).first;
    if (comes) {
        ++type->second.count;
        type->second.latest = sent.what.group;
    } else if (--type->second.count == 0) {
        m_types.erase(type);
    }
}

void Shadow::refuse(const std::string& text) {
    forgetRefused();
    if (m_refused.size() == kMostRefusals) m_refused.erase(m_refused.begin());
    m_refused.push_back({subjectOf(m_message).setting, m_message, text});
}

// A command that adds to a setting says nothing of the others that add to it.
void Shadow::forgetRefused() {
    const Subject subject = subjectOf(m_message);
    std::erase_if(m_refused, [&](const Refusal& refusal) {
        return refusal.setting == subject.setting && (!subject.adds || refusal.command == m_message);
    });
}

std::vector<std::string> Shadow::warnings() const {
    std::vector<std::string> warnings;
    Composer fresh([&warnings](const std::string& text) { warnings.push_back(text); });
    fresh.take(m_instrument.transmission());
    for (const Refusal& refusal : m_refused) warnings.push_back(refusal.text);
    return warnings;
}

bool Shadow::isRefused(std::string_view setting, std::string_view value) const {
    return std::any_of(m_refused.begin(), m_refused.end(), [&](const Refusal& refusal) {
        return refusal.setting == setting && refusal.command.find(value) != std::string::npos;
    });
}

}  // namespace kdx::air
