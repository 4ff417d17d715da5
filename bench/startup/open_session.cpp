// Opens the session to the virtual instrument with the real clock and prints how long it took against 50 ms for each
// pause that the commands and queries demand. Usage: open_session APP_FOLDER
#include <chrono>
#include <cstdio>

#include "base/clock.h"
#include "settings/captions.h"
#include "settings/datafolder.h"
#include "settings/folderlock.h"
#include "settings/programstate.h"
#include "sim/simvisa.h"
#include "sim/virtualinstrument.h"
#include "station/session.h"
#include "ui/application.h"
#include "ui/qtdialogs.h"
#include "ui/ticker.h"
#include "window/hmenue.h"

namespace {

class CommandCounter final : public kdx::TrafficWatcher {
public:
    explicit CommandCounter(kdx::Instrument& instrument) { instrument.addWatcher(*this); }
    void passed(const kdx::Traffic& traffic) override {
        if (traffic.kind == kdx::Traffic::Kind::Written) ++m_commands;
    }
    [[nodiscard]] int commands() const { return m_commands; }

private:
    int m_commands = 0;
};

}  // namespace

int main(int argc, char** argv) {
    if (argc < 2) return 2;
    qputenv("QT_QPA_PLATFORM", "offscreen");
    kdx::Application application(argc, argv);
    kdx::SystemClock clock;
    kdx::DataFolder data(argv[1]);
    kdx::ProgramState state;
    kdx::Captions captions(data);
    kdx::QtDialogs dialogs(captions);
    kdx::sim::VirtualInstrument instrument(clock);
    kdx::sim::SimVisa visa(instrument);
    kdx::Session session(visa, state, data, captions, clock, [] {});
    kdx::TickerGroup tickers;
    const kdx::FolderClaim claim(data.path());
    kdx::HMenue window({session, state, data, captions, clock, dialogs, tickers, claim, QString(), QString(), [] {}});
    window.startUp();
    window.show();
    CommandCounter counter(session.instrument);
    const auto start = std::chrono::steady_clock::now();
    window.INIT_Taste_Click();
    const std::chrono::duration<double, std::milli> taken = std::chrono::steady_clock::now() - start;
    const int commands = counter.commands() - 1;  // "*IDN?" goes out without a pause
    std::printf("commands=%d taken_ms=%.1f ratio=%.4f\n", commands, taken.count(), taken.count() / (commands * 50.0));
    return 0;
}
