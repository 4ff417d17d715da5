#include "app/choosevisa.h"

#include <algorithm>

#include "app/options.h"
#include "link/lanvisa.h"
#include "link/libraryvisa.h"
#include "settings/shownpath.h"
#include "sim/simvisa.h"
#include "sim/virtualinstrument.h"

namespace kdx {

ChosenVisa::ChosenVisa() = default;
ChosenVisa::~ChosenVisa() = default;
ChosenVisa::ChosenVisa(ChosenVisa&& other) noexcept = default;
ChosenVisa& ChosenVisa::operator=(ChosenVisa&& other) noexcept = default;

LanOptions lanOptions(const Options& options) {
    LanOptions lan;
    if (!options.answerTime) return lan;
    lan.ioTimeout = *options.answerTime;
    lan.answerMargin = std::min(lan.answerMargin, lan.ioTimeout / 5);
    return lan;
}

ChosenVisa chooseVisa(const Options& options, const Clock& clock) {
    ChosenVisa chosen;
    if (options.simulate) {
        chosen.simulated = std::make_unique<sim::VirtualInstrument>(clock);
        chosen.visa = std::make_unique<sim::SimVisa>(*chosen.simulated);
        chosen.description = "Virtual instrument inside the program";
        return chosen;
    }
    VisaLibrary library = loadVisaLibrary(options.visaLibrary.value_or(std::string()), options.answerTime);
    if (library.visa) {
        chosen.visa = std::move(library.visa);
        chosen.description = "VISA library " + shownText(library.file);
        return chosen;
    }
    if (options.visaLibrary) {
        chosen.description = "The VISA library cannot be used: " + library.reason;
        return chosen;
    }
    chosen.visa = std::make_unique<LanVisa>(lanOptions(options));
    chosen.description = "Built-in LAN client (VXI-11); no VISA library found:\n" + library.reason;
    return chosen;
}

}  // namespace kdx
