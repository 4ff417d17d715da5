#include "app/ctl/laboratory.h"

#include <utility>

#include "af/settings.h"
#include "app/appfolder.h"
#include "app/platform.h"
#include "base/codepage.h"
#include "base/paths.h"
#include "base/printable.h"
#include "coder/keyfacts.h"
#include "coder/sendparam.h"
#include "link/resource.h"
#include "link/visastatus.h"
#include "settings/generalsettings.h"
#include "settings/shippedfiles.h"
#include "settings/storedvalue.h"
#include "settings/withoutcontrols.h"
#include "sim/virtualinstrument.h"
#include "station/wrongsettings.h"

namespace kdx::ctl {

namespace {

std::filesystem::path folderOf(const Call& call, Output& output, const char* program) {
    DataNews news;
    auto folder = appFolder(call.program, program, errorIsTerminal(), news);  // nobody may read what a script prints
    if (!news.problem.empty()) output.problem(news.problem);
    for (const auto& shipped : news.kept) output.warning(keptFileText(shipped));
    return folder;
}

/// What the user can do about a status.
std::string advice(VisaStatus status) {
    switch (status) {
        case visa::kTimeout:
            return "The instrument keeps silent: look whether it is busy, or locked at its front panel.";
        case visa::kConnectionLost:
        case visa::kInputOutput:
            return "Look whether it is switched on and the cable is plugged in, then try again.";
        case visa::kResourceNotFound:
            return "Look at the address, and whether the instrument is switched on.";
        case visa::kLibraryNotFound:
            return "GPIB needs an installed VISA library; --visa-library names one.";
        case visa::kResourceLocked:
            return "Another program holds it locked.";
        default:
            return "kdx-ctl -v shows every command with its status.";
    }
}

}  // namespace

Laboratory::Laboratory(const Call& call, Output& output, const char* program, int stop)
    : m_call(call),
      m_output(output),
      m_stop(stop),
      m_data(folderOf(call, output, program)),
      m_captions(m_data),
      m_link(chooseVisa(call.program, m_clock)) {
    if (!m_link.visa) return;
    m_session = std::make_unique<Session>(*m_link.visa, m_state, m_data, m_captions, m_clock, [this] {
        // A data set that holds the key which ends the program: the rest is not sent.
        m_output.problem("the key DS ended the run");
        m_stopped = true;
        m_session->transmitter.stop();
    });
    const Profile& profile = m_session->profile;
    m_state.LogEnabled = isSwitchedOn(profile.read(setting::kCommandLogOn));
    m_session->readCorrections();
    m_captions.load(languageOrDesign(profile.read(setting::kLanguage)), profile.read(setting::kStandard));
    m_session->transmitter.setWatcher(this);
    m_session->instrument.onFailure([this](const std::string&, bool) { return linkFailed(); });
    m_session->instrument.addWatcher(*this);
    m_session->instrument.log.onChange([this, told = false]() mutable {
        if (m_session->instrument.log.isWritable() || std::exchange(told, true)) return;
        m_output.problem("the command log " + utf8Of(m_data.file(kCommandLog)) + " cannot be written");
    });
}

Laboratory::~Laboratory() {
    if (!m_session) return;
    m_session->instrument.removeWatcher(*this);
    m_session->instrument.onFailure(nullptr);
}

bool Laboratory::open() {
    // A run goes on over midnight, whatever the general settings say of the window: nobody sits by a script.
    m_clock.correctMidnight(true);
    if (m_session && m_held && m_session->instrument.isOpen()) return true;
    if (!m_session) {
        m_output.problem(m_link.description);
        return false;
    }
    const Profile& profile = m_session->profile;
    auto [kind, address] = m_session->storedAddress();
    if (m_call.lan) {
        kind = kLanInterface;
        address = withoutControls(*m_call.lan);
        if (const auto comma = address.find(','); comma != std::string::npos) address.replace(comma, 1, "::");
    } else if (m_call.gpib) {
        kind = kGpibInterface;
        address = std::to_string(*m_call.gpib);
    } else if (address.empty() && !m_call.program.simulate) {
        m_output.problem("no instrument is named: " + utf8Of(m_data.file(kGeneralSettings)) +
                         (m_data.profile(kGeneralSettings) ? " has no address" : " cannot be read") +
                         ". Name it with --lan or --gpib, or the folder with your settings with --app-folder.");
        return false;
    }
    if (m_session->open(kind, address) == visa::kSuccess) {
        // Commands about the other network are led by the one of the data set, until another one is sent.
        m_state.eonIdentifier = profile.read(setting::kEonPi.place);
        if (m_lost) reconnected();
        return true;
    }
    const std::string place = isLan(kind) ? address : "GPIB address " + address;
    const std::string problem = "no connection to " + place + ": " + statusText();
    // A script learns once that the link is lost, a person with every line.
    if (m_lost && !inputIsTerminal()) {
        m_output.note(problem);
    } else {
        m_output.problem(problem);
    }
    return false;
}

void Laboratory::reconnected() {
    m_lost = false;
    m_output.remark("connected again");
    m_output.document["connected_again"] = true;
}

void Laboratory::close() {
    if (!m_held) m_session->close();
}

void Laboratory::nextTask() {
    m_failed = false;
    m_refused = false;
    expect(0);
    if (m_lost) m_session->instrument.close();
}

void Laboratory::expect(std::size_t commands) {
    m_written = 0;
    m_expected = commands;
}

bool Laboratory::pause(std::chrono::milliseconds duration) {
    waitReadable(m_stop, duration);
    return !isStopped();
}

int Laboratory::result() const {
    if (m_failed || m_stopped) return kFailed;
    return m_refused ? kDifferent : kDone;
}

bool Laboratory::goesOn() {
    return !isStopped() && (!m_failed || m_call.continues);
}

bool Laboratory::mayBeSent(const std::string& key, const std::string& utf8) {
    // There is nothing that could be sent for an unknown key.
    if (m_call.force && isParameter(key)) return true;
    const auto wrong = wrongTypedValue(key, utf8, m_state.corrections);
    if (wrong) m_output.problem(isParameter(key) ? *wrong : *wrong + "; kdx-ctl list keys names them");
    return !wrong;
}

bool Laboratory::mayBeSent(const Profile& source) {
    if (m_call.force) return true;
    const auto wrong = wrongSettings(source);
    for (const WrongSetting& setting : wrong) m_output.problem(setting.sentence);
    return wrong.empty();
}

void Laboratory::passed(const Traffic& traffic) {
    if (traffic.kind == Traffic::Kind::Logged) return;
    // Between two questions, never between a question and its answer. What is read after that, to bring back what stood
    // before, is read to its end.
    const bool mayStop = traffic.kind == Traffic::Kind::Read && !m_stopped && !m_finishing;
    if (mayStop && isStopped()) m_session->instrument.stopSequence();
    const bool written = traffic.kind == Traffic::Kind::Written;
    if (written && !m_inSteps) m_output.progress(++m_written, m_expected);
    // What nobody wants to have would grow for as long as a run lasts.
    if (!m_call.verbose && !m_call.json) return;
    const std::string text = toUtf8(printableLine(traffic.text, '.'));
    if (m_call.verbose) {
        std::string words;
        if (traffic.status != 0) (void)describeStatus(traffic.status, words);
        const std::string status = std::to_string(traffic.status) + (words.empty() ? "" : ": " + words);
        m_output.line(timeText(m_clock) + (written ? " -> " : " <- ") + text + "  [" + status + "]");
    }
    if (!m_call.json) return;
    m_output.document["traffic"].push_back(
        {{"direction", written ? "written" : "read"}, {"text", text}, {"status", traffic.status}});
}

void Laboratory::stepGoesOut(const Step& step, std::size_t number, std::size_t total) {
    m_inSteps = true;
    if (number > 0) m_output.progress(number, total);
    if (step.kind == Step::Kind::Refused) {
        m_refused = true;
        m_output.problem(step.key + " is not sent: the coder cannot take so many frequencies with method B");
    }
    if (!m_finishing && isStopped()) m_session->transmitter.stop();
}

void Laboratory::stepsEnded() {
    m_inSteps = false;
    m_output.endProgress();
}

bool Laboratory::isStopped() {
    if (!m_stopped && isReadable(m_stop)) {
        m_output.problem("stopped");
        m_stopped = true;
    }
    return m_stopped;
}

/// @returns whether the rest is not to be sent.
bool Laboratory::linkFailed() {
    if (!m_failed) m_output.problem("the link to the instrument is broken: " + statusText());
    m_failed = true;
    if (m_held && m_session->instrument.LastVisaStatus == visa::kConnectionLost) m_lost = true;
    return !m_call.continues;
}

std::string Laboratory::statusText() const {
    const VisaStatus status = m_session->instrument.LastVisaStatus;
    std::string words;
    (void)describeStatus(status, words);
    return words + " (" + std::to_string(status) + "). " + advice(status);
}

}  // namespace kdx::ctl
