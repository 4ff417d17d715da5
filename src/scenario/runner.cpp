#include "scenario/runner.h"

#include <algorithm>
#include <exception>
#include <utility>

#include "af/settings.h"
#include "base/codepage.h"
#include "base/printable.h"
#include "base/split.h"
#include "scenario/questions.h"
#include "settings/programstate.h"
#include "station/session.h"
#include "tmc/groupcode.h"
#include "tmc/settings.h"

namespace kdx::scenario {

namespace {

constexpr std::chrono::milliseconds kCommandPause{kCommandPauseMs};
constexpr int kRestoringTries = 5;  // an instrument that keeps silent for some seconds answers again
constexpr std::chrono::seconds kBetweenTries{1};
constexpr std::chrono::nanoseconds kOthersTurn{0};      // who has other things to do may do them between two commands
constexpr std::chrono::milliseconds kLongestSleep{50};  // who stops a run or presses Return need not wait longer

using Kind = Action::Kind;

std::string shown(const std::string& bytes) {
    return toUtf8(printableLine(bytes, '.'));
}

std::string shown(const std::vector<std::string>& values) {
    std::vector<std::string> texts(values.size());
    std::transform(values.begin(), values.end(), texts.begin(), [](const std::string& value) { return shown(value); });
    return joined(texts, ",");
}

}  // namespace

Runner::Runner(const Surroundings& with) : m_with(with), m_schedule(with.clock) {
    m_with.session.instrument.addWatcher(*this);
}

Runner::~Runner() {
    m_with.session.instrument.removeWatcher(*this);
}

/// What is asked meanwhile is no row of the report.
template <typename Asks>
auto Runner::silently(Asks asks) {
    m_questions.emplace();
    auto answer = asks();
    m_questions.reset();
    return answer;
}

Outcome Runner::run(const Scenario& scenario, RunOptions options) {
    start(scenario, std::move(options));
    while (const auto pause = goOn()) {
        if (pause->count() > 0) m_with.clock.sleep(*pause);
    }
    return m_outcome;
}

void Runner::start(const Scenario& scenario, RunOptions options) {
    m_options = std::move(options);
    m_whole.emplace(whole(scenario));
    m_whole->beginIn(m_pauses);
}

std::optional<std::chrono::nanoseconds> Runner::goOn() {
    const auto pause = m_pauses.goOn();
    if (!pause) (void)m_whole->result();
    return pause;
}

Runner::Course Runner::whole(const Scenario& scenario) {
    const bool restores = scenario.restore && m_with.restorer != nullptr;
    const bool begins = !restores || silently([&] { return m_with.restorer->remember(); });
    if (begins) {
        std::exception_ptr failure;  // nothing can be waited for while it is caught
        try {
            (void)co_await play(scenario);
        } catch (...) {
            failure = std::current_exception();
        }
        if (restores) (void)co_await bringBack();
        if (failure) std::rethrow_exception(failure);
    }
    m_with.watcher.ended(m_outcome);
    co_return Flow::Ends;
}

Runner::Course Runner::play(const Scenario& scenario) {
    m_place = kOpening;
    if (scenario.dataSet) {
        m_wholeSent = true;
        if (m_with.sendDataSet) {
            m_with.sendDataSet();
        } else {
            m_with.session.sendOpening();
        }
    }
    m_place.clear();
    m_schedule.goOnFromNow();
    Flow flow = Flow::Ends;
    if (goesOn()) flow = co_await list(scenario.actions);
    m_outcome.complete = flow != Flow::Ends && goesOn();
    co_return flow;
}

Runner::Course Runner::bringBack() {
    m_with.attendant.finishes();
    const std::set<std::string> sent = std::exchange(m_sent, {});
    m_place = kRestoring;
    m_setting = {};
    m_outcome.restored = bringBackOnce();
    for (int left = kRestoringTries - 1; left > 0 && !m_outcome.restored; --left) {
        co_await m_pauses.pause(kBetweenTries);
        m_outcome.restored = bringBackOnce();
    }
    if (!m_outcome.restored) m_outcome.changed.assign(sent.begin(), sent.end());
    for (const std::string& key : m_with.restorer->untold()) {
        const bool wasSet = m_wholeSent || std::any_of(sent.begin(), sent.end(), [&](const std::string& other) {
                                return setsReading(other, key);
                            });
        if (wasSet) m_outcome.untold.push_back(key);
    }
    co_return Flow::Ends;
}

bool Runner::bringBackOnce() {
    const auto commands = silently([&] { return m_with.restorer->commands(); });
    if (!commands) return false;
    bool allSent = true;
    for (const auto& [key, command] : *commands) {
        m_setting.first = key;
        m_with.session.params.sendCommand(key, command);
        if (m_with.session.instrument.LastVisaStatus != visa::kSuccess) allSent = false;
    }
    const auto changed = silently([&] { return m_with.restorer->changed(); });
    m_outcome.changed = changed.value_or(std::vector<std::string>());
    return allSent && changed;
}

Runner::Course Runner::list(const std::vector<Action>& actions) {
    std::size_t begin = 1;
    if (m_options.from) {
        const auto& parts = m_options.from->parts;
        const StepNumber::Part part = parts[m_number.parts.size()];
        begin = part.step;
        if (m_number.parts.size() + 1 == parts.size() && part.pass == 0) m_options.from.reset();
    }
    m_number.parts.emplace_back();
    Flow flow = Flow::Next;
    for (std::size_t step = begin; step <= actions.size() && flow == Flow::Next; ++step) {
        m_number.parts.back() = {step, 0};
        flow = co_await one(actions[step - 1]);
        if (flow == Flow::Next) flow = unlessReached();
    }
    m_number.parts.pop_back();
    co_return flow;
}

Runner::Course Runner::one(const Action& action) {
    co_await m_pauses.pause(kOthersTurn);
    if (!goesOn()) co_return Flow::Ends;
    const bool asks = action.kind == Kind::Pause || action.untilReturn;
    if (asks && !m_options.nobodyThere) m_with.attendant.forgetsTyped();
    m_with.watcher.begins(m_number.text(), action);
    switch (action.kind) {
        case Kind::Send:
            co_return co_await sendAll(action);
        case Kind::Wait:
            m_schedule.wait(action.time);
            co_return co_await waitUntil(m_schedule.due());
        case Kind::Expect:
            co_return co_await expect(action);
        case Kind::Sweep:
        case Kind::Repeat:
            co_return co_await loop(action);
        case Kind::TrafficMessage:
            co_return message(action.text);
        case Kind::Pause:
            co_return co_await pause(action);
        case Kind::Note:
            tell({{}, {}, kNoteRow, action.text, {}, {}, {}});
            co_return afterCommand();
    }
    co_return Flow::Next;
}

Runner::Course Runner::loop(const Action& action) {
    std::size_t first = 1;
    if (m_options.from) {
        const auto& parts = m_options.from->parts;
        first = std::max<std::size_t>(parts[m_number.parts.size() - 1].pass, 1);
        if (m_number.parts.size() == parts.size()) m_options.from.reset();
    }
    // Commands before a sweep have taken their time: the first point is to last as long as the others.
    const bool late = m_with.clock.steadyNow() - m_schedule.due() > kCommandPause;
    if (action.kind == Kind::Sweep && late) m_schedule.goOnFromNow();
    const bool listens = action.untilReturn && !m_options.nobodyThere;
    if (listens) ++m_listening;
    const Flow flow = co_await passes(action, first);
    if (listens) --m_listening;
    if (action.untilReturn && (flow == Flow::Next || flow == Flow::Returned)) {
        // What was reached when the person pressed Return is what the loop was for.
        const std::size_t pass = std::min(m_number.parts.back().pass, passesOf(action));
        const bool sweeps = action.kind == Kind::Sweep;
        tell({{},
              {},
              sweeps ? action.key : kRepeatRow,
              sweeps ? action.points[pass - 1] : std::to_string(pass),
              {},
              flow == Flow::Returned ? kReturn : kNoReturn,
              {}});
    }
    m_number.parts.back().pass = 0;
    if (flow != Flow::Returned || !listens) co_return flow;
    m_schedule.goOnFromNow();
    co_return afterCommand();
}

Runner::Course Runner::passes(const Action& action, std::size_t first) {
    for (std::size_t number = first; number <= passesOf(action); ++number) {
        m_number.parts.back().pass = number;
        if (!goesOn()) co_return Flow::Ends;
        Flow flow = co_await pass(action);
        if (flow == Flow::Next) flow = unlessReached();
        if (flow != Flow::Next) co_return flow;
    }
    co_return Flow::Next;
}

/// A sweep's point lasts `time` at least, its steps included.
Runner::Course Runner::pass(const Action& action) {
    const Schedule::Time begin = m_schedule.due();
    if (action.kind == Kind::Sweep && send(action.key, action.points[m_number.parts.back().pass - 1]) == Flow::Ends)
        co_return Flow::Ends;
    Flow flow = Flow::Next;
    if (!action.actions.empty()) flow = co_await list(action.actions);
    if (flow != Flow::Next) co_return flow;
    m_schedule.waitUntil(begin + action.time);
    co_return co_await waitUntil(m_schedule.due());
}

Runner::Course Runner::sendAll(const Action& action) {
    for (const auto& [key, value] : action.settings) {
        if (send(key, value) == Flow::Ends) co_return Flow::Ends;
        co_await m_pauses.pause(kOthersTurn);
    }
    co_return afterCommand();
}

Runner::Flow Runner::send(const std::string& key, const std::string& value) {
    // Commands about the other network are led by the PI that was sent last.
    if (key == setting::kEonPi.sendKey) m_with.state.eonIdentifier = value;
    m_setting = {key, value};
    m_with.session.params.SendParam(key, std::string(value));
    return afterCommand();
}

Runner::Flow Runner::message(const std::string& code) {
    const bool other = m_otherVariant;
    m_otherVariant = !m_otherVariant;
    if (send(setting::kOpenDataAnnouncement.sendKey, announcement(other)) == Flow::Ends) return Flow::Ends;
    return send(setting::kTrafficMessage.sendKey, sentMessage(code));
}

Runner::Course Runner::expect(const Action& action) {
    const Schedule::Time begin = m_with.clock.steadyNow();
    bool waited = false;
    for (const Action::Expectation& expectation : action.expected) {
        Row row{{}, {}, expectation.name, shown(expectation.values), {}, {}, {}};
        const Flow flow = co_await askUntilMet(expectation, begin + action.time, row, waited);
        const bool cutOff = row.status == kNotMet && m_with.clock.steadyNow() < begin + action.time;
        if (cutOff) row.status = kCutOff;  // stopped: it might have been met yet
        tell(row);
        if (row.status == kNotMet) ++m_outcome.unmet;
        if (flow != Flow::Next) co_return flow;
    }
    if (waited) m_schedule.goOnFromNow();
    co_return afterCommand();
}

Runner::Course Runner::askUntilMet(const Action::Expectation& expectation, Schedule::Time deadline, Row& row,
                                   bool& waited) {
    for (;;) {
        const Schedule::Time asked = m_with.clock.steadyNow();
        const auto question = questionOf(expectation.name, m_with.state.eonIdentifier).value();
        m_questions.emplace();
        const auto answers = ask(m_with.session.instrument, question);
        row.command = *std::exchange(m_questions, std::nullopt);
        row.answer = shown(answers);
        const bool met =
            std::equal(answers.begin(), answers.end(), expectation.values.begin(), expectation.values.end(), isAnswer);
        row.status = met ? kMet : kNotMet;
        if (!goesOn()) co_return Flow::Ends;
        if (met || m_with.clock.steadyNow() >= deadline) co_return Flow::Next;
        waited = true;
        const Flow flow = co_await waitUntil(std::min(asked + kPollInterval, deadline));
        if (flow != Flow::Next) co_return flow;
    }
}

Runner::Course Runner::pause(const Action& action) {
    Row row{{}, {}, kPauseRow, action.text, {}, kGoesOn, {}};
    Flow flow = Flow::Next;
    if (!m_options.nobodyThere) {
        auto pressed = Attendant::Return::NotYet;
        while (pressed == Attendant::Return::NotYet && goesOn()) {
            pressed = m_with.attendant.pressed();
            if (pressed == Attendant::Return::NotYet) co_await m_pauses.pause(kLongestSleep);
        }
        row.status = pressed == Attendant::Return::Pressed ? kReturn : kNoReturn;
        if (pressed != Attendant::Return::Pressed) flow = Flow::Ends;
        m_schedule.goOnFromNow();
    }
    tell(row);
    co_return flow == Flow::Next ? afterCommand() : flow;
}

Runner::Course Runner::waitUntil(Schedule::Time time) {
    for (bool told = false;; told = true) {
        if (!goesOn()) co_return Flow::Ends;
        if (m_listening > 0 && m_with.attendant.pressed() == Attendant::Return::Pressed) co_return Flow::Returned;
        const auto left = time - m_with.clock.steadyNow();
        if (left.count() <= 0) co_return Flow::Next;
        if (!told) m_with.watcher.waits(left);
        co_await m_pauses.pause(std::min<std::chrono::nanoseconds>(left, kLongestSleep));
    }
}

void Runner::tell(Row row) {
    row.time = dateAndTime(m_with.clock);
    row.step = m_place.empty() ? m_number.text() : m_place;
    m_with.watcher.happened(row);
    if (m_with.report == nullptr || m_outcome.reportLost || m_with.report->add(row)) return;
    m_outcome.reportLost = true;
    m_with.watcher.reportLost();
}

void Runner::passed(const Traffic& traffic) {
    if (traffic.kind != Traffic::Kind::Written) return;
    if (m_questions) {
        m_questions->append(m_questions->empty() ? "" : "; ").append(shown(traffic.text));
        return;
    }
    const auto& [key, value] = m_setting;
    if (!key.empty()) m_sent.insert(key);
    tell({{}, {}, key, toUtf8(value), shown(traffic.text), std::to_string(traffic.status), {}});
}

}  // namespace kdx::scenario
