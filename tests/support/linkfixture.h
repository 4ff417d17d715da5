#pragma once

#include <functional>
#include <string>
#include <utility>
#include <vector>

#include "coder/sendparam.h"
#include "coder/step.h"
#include "link/instrument.h"
#include "settings/captions.h"
#include "settings/datafolder.h"
#include "settings/profile.h"
#include "settings/programstate.h"
#include "support/fakeclock.h"
#include "support/fakevisa.h"
#include "support/tempfolder.h"

namespace kdx::test {

using Lines = std::vector<std::string>;

/// The file of data set 1.
inline constexpr const char* kSet1 = "Datenset1.INI";

/// A coder command as it goes to the instrument.
inline std::string direct(const std::string& command) {
    return ":STEREO:DIRECT \"" + command + "\"";
}
/// A question to the coder as it goes to the instrument.
inline std::string coder(const std::string& query) {
    return ":STEREO:DIRECT? \"" + query + "\"";
}

/// The step of a parameter.
inline Step parameter(const char* key, const std::string& value) {
    return {.key = key, .value = value};
}

/// Hands what passes on the link to a function.
class TrafficListener final : public TrafficWatcher {
public:
    TrafficListener(Instrument& instrument, std::function<void(const Traffic&)> heard)
        : m_instrument(instrument), m_heard(std::move(heard)) {
        m_instrument.addWatcher(*this);
    }
    ~TrafficListener() override { m_instrument.removeWatcher(*this); }
    TrafficListener(const TrafficListener&) = delete;
    TrafficListener& operator=(const TrafficListener&) = delete;
    void passed(const Traffic& traffic) override { m_heard(traffic); }

private:
    Instrument& m_instrument;
    std::function<void(const Traffic&)> m_heard;
};

/// What everything works with: a data folder of its own, a scripted instrument, a clock that stands still.
struct Bench {
    TempFolder folder;
    DataFolder data{folder.path()};
    FakeVisa visa;
    FakeClock clock;
    ProgramState state;
    Captions captions{data};
    Profile settings = Profile::followingDataSet(data, state.CurrentDataSet);

    /// Every command sent since the last call, in order.
    Lines sent() { return std::exchange(visa.written, {}); }
    [[nodiscard]] std::string profile(const std::string& file, const std::string& section,
                                      const std::string& key) const {
        return data.ReadIni(section, key, file);
    }
    void setProfile(const std::string& file, const std::string& section, const std::string& key,
                    const std::string& value) {
        data.WriteIni(section, key, value, file);
    }
};

/// A bench with a link and its dispatcher. Failures are kept, not shown.
struct LinkFixture : Bench {
    LinkFixture() {
        instrument.onFailure([this](const std::string& text, bool sequenceRuns) {
            failures.push_back(text);
            return sequenceRuns && stopAtFailure;
        });
    }

    Instrument instrument{visa, state, data, captions, clock};
    int ended = 0;  ///< how often the end of the program was asked for
    ParamSender params{instrument, state, clock, [this] { ++ended; }};
    Lines failures;              ///< texts of the boxes that failures would show
    bool stopAtFailure = false;  ///< press the button that stops the running sequence
};

}  // namespace kdx::test
