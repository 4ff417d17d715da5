#include "station/session.h"

#include "base/clock.h"
#include "link/resource.h"
#include "settings/generalsettings.h"
#include "settings/programstate.h"

namespace kdx {

Session::Session(Visa& visa, ProgramState& state, DataFolder& data, const Captions& captions, Clock& clock,
                 std::function<void()> endProgram)
    : instrument(visa, state, data, captions, clock),
      params(instrument, state, clock, std::move(endProgram)),
      transmitter(instrument, params),
      profile(Profile::followingDataSet(data, state.CurrentDataSet, &state.openedFile)),
      m_state(state),
      m_captions(captions),
      m_clock(clock),
      m_source(profile) {}

Session::~Session() {
    letGo();
}

void Session::letGo() {
    if (instrument.isOpen() && !m_kept) instrument.close();
}

void Session::load(const Profile& source) {
    m_source = source;
    readCorrections();
    station.load(source);
}

void Session::loadDataSet() {
    m_source = profile;
    station.loadDataSet(profile);
}

void Session::readCorrections() {
    m_state.corrections = kdx::readCorrections(profile);
    m_clock.correctMidnight(m_state.corrections.midnight);
}

InstrumentAddress Session::storedAddress() const {
    const std::string kind = profile.read(setting::kInterface);
    return {kind, profile.read(isLan(kind) ? setting::kLanAddress : setting::kGpibAddress)};
}

bool Session::sendOpening() {
    lookUp();
    return transmitter.run(openingSteps(station, m_state.corrections));
}

bool Session::sendDataSet() {
    lookUp();
    return transmitter.run(dataSetSteps(station, m_state.corrections));
}

void Session::close() {
    transmitter.run(closingSteps());
}

void Session::lookUp() {
    station.reload(m_source);
    OtherNetwork& network = station.otherNetwork;
    m_state.eonIdentifier = network.pi;  // leads every command about the network
    if (m_state.corrections.eonType) network.pty = programmeTypeNumber(network.pty, m_captions);
}

}  // namespace kdx
