// Opens a session to the virtual instrument and the view of what is on the air, and prints which share of one core the
// whole program takes while the view is open. Usage: open_view APP_FOLDER SECONDS
#include <QAction>
#include <QTimer>

#include <sys/resource.h>

#include <chrono>
#include <cstdio>
#include <cstdlib>

#include "benchedprogram.h"
#include "sim/simvisa.h"
#include "sim/virtualinstrument.h"
#include "ui/application.h"
#include "window/hmenue.h"

namespace {

double processorSeconds() {
    rusage usage{};
    ::getrusage(RUSAGE_SELF, &usage);
    const auto seconds = [](const timeval& time) {
        return static_cast<double>(time.tv_sec) + static_cast<double>(time.tv_usec) / 1e6;
    };
    return seconds(usage.ru_utime) + seconds(usage.ru_stime);
}

}  // namespace

int main(int argc, char** argv) {
    if (argc < 3) return 2;
    kdx::Application application(argc, argv);
    const kdx::SystemClock clock;
    kdx::sim::VirtualInstrument instrument(clock);
    kdx::sim::SimVisa visa(instrument);
    kdx::BenchedProgram program(argv[1], visa);
    kdx::HMenue window(program.surroundings());
    window.startUp();
    window.show();
    window.INIT_Taste_Click();
    auto* const entry = window.findChild<QAction*>(QStringLiteral("Mnu_Ansicht_OnAir"));
    if (entry == nullptr) return 1;
    entry->trigger();
    double before = 0;
    const std::chrono::seconds measured(std::atoi(argv[2]));
    QTimer::singleShot(std::chrono::seconds(3), &application, [&] { before = processorSeconds(); });
    QTimer::singleShot(std::chrono::seconds(3) + measured, &application, [&] {
        std::printf("share=%.4f\n", (processorSeconds() - before) / static_cast<double>(measured.count()));
        application.quit();
    });
    return application.exec();
}
