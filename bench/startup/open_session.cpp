// Opens the session to the virtual instrument with the real clock and prints how long it took, and how many commands
// and queries with a pause there were. Usage: open_session APP_FOLDER
#include <chrono>
#include <cstdio>

#include "benchedprogram.h"
#include "sim/simvisa.h"
#include "sim/virtualinstrument.h"
#include "ui/application.h"
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
    const kdx::SystemClock clock;
    kdx::sim::VirtualInstrument instrument(clock);
    kdx::sim::SimVisa visa(instrument);
    kdx::BenchedProgram program(argv[1], visa);
    kdx::HMenue window(program.surroundings());
    window.startUp();
    window.show();
    CommandCounter counter(program.session.instrument);
    const auto start = std::chrono::steady_clock::now();
    window.INIT_Taste_Click();
    const std::chrono::duration<double, std::milli> taken = std::chrono::steady_clock::now() - start;
    const int commands = counter.commands() - 1;  // "*IDN?" goes out without a pause
    std::printf("commands=%d taken_ms=%.1f\n", commands, taken.count());
    return 0;
}
