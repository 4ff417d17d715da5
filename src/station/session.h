#pragma once

#include <functional>
#include <string>

#include "coder/sendparam.h"
#include "link/instrument.h"
#include "settings/profile.h"
#include "station/station.h"
#include "station/transmitter.h"

namespace kdx {

/// Where an instrument is.
struct InstrumentAddress {
    std::string kind;  ///< kGpibInterface or kLanInterface
    std::string address;
};

/// What a program that works with one instrument is made of, window or not: the link, what goes over it, and the data
/// set at work. Everything else is lent and outlives it.
struct Session {
    Session(Visa& visa, ProgramState& state, DataFolder& data, const Captions& captions, Clock& clock,
            std::function<void()> endProgram);
    /// Lets the instrument go when a session is open still: others would find it taken.
    ~Session();
    Session(const Session&) = delete;
    Session& operator=(const Session&) = delete;

    /// Loads the data set of the profile, or of any other source; whatever is looked up at sending comes from there.
    /// What the general settings correct holds from here on.
    void load() { load(profile); }
    void load(const Profile& source);
    /// Loads the data set at work, another one than before; multiplex and carrier belong to none and stay.
    void loadDataSet();
    /// What the general settings correct of the program's ways holds from here on; called anew when they change.
    void readCorrections();
    /// Opens the session to the address; see Instrument::open.
    VisaStatus open(const std::string& kind, const std::string& address) { return instrument.open(kind, address); }
    /// Where the general settings say that the instrument is.
    [[nodiscard]] InstrumentAddress storedAddress() const;
    /// Sends what belongs to the opening, the whole data set among it. @returns false when it was stopped.
    bool sendOpening();
    /// Sends the whole data set. @returns false when it was stopped.
    bool sendDataSet();
    /// Closes the session.
    void close();
    /// What is done when this goes: closes what is open still, unless it is to be kept.
    void letGo();
    /// Lets an open session be when this goes: the instrument stays in remote.
    void keepOpen() { m_kept = true; }

    Instrument instrument;
    ParamSender params;
    Transmitter transmitter;
    Profile profile;  ///< with the current data set
    Station station;

private:
    void lookUp();

    ProgramState& m_state;
    const Captions& m_captions;
    Clock& m_clock;
    bool m_kept = false;
    Profile m_source;
};

}  // namespace kdx
