#include "air/deviations.h"

#include <algorithm>

#include "sim/setup.h"

namespace kdx::air {

namespace {

constexpr int kAnnouncementOnly = 1;  // of the choices DK, BK, BKDK
constexpr int kAreaOnly = 2;

double tonesOf(const sim::Setup& setup) {
    if (!setup.ariTypeOn) return 0;
    return (setup.ariType == kAreaOnly ? 0 : kAnnouncementDepth) +
           (setup.ariType == kAnnouncementOnly ? 0 : kAreaDepth);
}

}  // namespace

Deviations deviationsOf(const sim::Setup& setup) {
    Deviations of;
    if (!setup.stereoOn) return of;
    of.total = setup.mpxHertz;
    of.pilot = setup.pilotOn ? setup.pilotHertz : 0;
    of.rds = setup.rdsOn ? setup.rdsHertz : 0;
    of.ariCarrier = setup.ariOn ? setup.ariHertz : 0;
    of.ari = of.ariCarrier * (1 + tonesOf(setup));
    // RDS stands in quadrature to ARI and adds less than its whole; the plain sum keeps within the total all the same.
    of.audio = std::max(0.0, of.total - of.subcarriers());
    return of;
}

}  // namespace kdx::air
