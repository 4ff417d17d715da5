#include "station/station.h"

#include "settings/datafolder.h"
#include "settings/profile.h"

namespace kdx {

namespace {

void appendDataSet(Steps& steps, const Station& station, const Corrections& corrections) {
    station.multiplex.appendSteps(steps, corrections);
    station.programme.appendSteps(steps);
    station.af.appendSteps(steps);
    station.programme.appendPtySteps(steps);
    station.otherNetwork.appendSteps(steps, corrections);
    station.groups.appendSteps(steps);
    station.carrier.appendSteps(steps, corrections);
}

}  // namespace

void Station::load(const Profile& profile) {
    multiplex.load(profile);
    loadDataSet(profile);
    carrier.load(profile);
}

void Station::loadDataSet(const Profile& profile) {
    programme.load(profile);
    af.load(profile);
    otherNetwork.load(profile);
    groups.load(profile);
}

void Station::reload(const Profile& profile) {
    af.load(profile);
    otherNetwork.loadLists(profile);
    carrier.load(profile);
}

Station loadStation(DataFolder& data, const std::string& number) {
    Station station;
    station.load(Profile::ofFile(data, dataSetFile(number)));
    return station;
}

Steps openingSteps(const Station& station, const Corrections& corrections) {
    Steps steps{{Step::Kind::Identify}};
    for (const char* key : {"AM_AUS", "FM_AUS", "STEREO_EIN"}) appendStep(steps, key, "");
    station.multiplex.appendOpeningSteps(steps, corrections);
    appendDataSet(steps, station, corrections);
    station.carrier.appendOpeningSteps(steps, corrections);
    return steps;
}

Steps dataSetSteps(const Station& station, const Corrections& corrections) {
    Steps steps;
    station.multiplex.appendImpedanceStep(steps, corrections);
    appendDataSet(steps, station, corrections);
    return steps;
}

Steps closingSteps() {
    return {{Step::Kind::Close}};
}

}  // namespace kdx
