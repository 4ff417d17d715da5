// Opens the session to the virtual instrument with the real clock and prints how long it took against 50 ms for each
// pause that the commands and queries demand. Usage: open_session APP_FOLDER
#include <chrono>
#include <cstdio>

#include "base/clock.h"
#include "settings/captions.h"
#include "settings/datafolder.h"
#include "settings/programstate.h"
#include "sim/simvisa.h"
#include "sim/virtualinstrument.h"
#include "ui/application.h"
#include "window/hmenue.h"
#include "ui/qtdialogs.h"

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
    kdx::HMenue window({visa, state, data, captions, clock, dialogs, QString(), [] {}});
    window.startUp();
    window.show();
    int commands = -1;  // "*IDN?" goes out without a pause
    QObject::connect(&window, &kdx::HMenue::trafficPassed, [&](const kdx::Traffic& traffic) {
        if (traffic.kind == kdx::Traffic::Kind::Written) ++commands;
    });
    const auto start = std::chrono::steady_clock::now();
    window.INIT_Taste_Click();
    const std::chrono::duration<double, std::milli> taken = std::chrono::steady_clock::now() - start;
    std::printf("commands=%d taken_ms=%.1f ratio=%.4f\n", commands, taken.count(), taken.count() / (commands * 50.0));
    return 0;
}
