#pragma once

#include "base/clock.h"
#include "settings/captions.h"
#include "settings/datafolder.h"
#include "settings/folderlock.h"
#include "settings/programstate.h"
#include "station/session.h"
#include "ui/qtdialogs.h"
#include "ui/ticker.h"
#include "window/surroundings.h"

namespace kdx {

/// What the program makes before its window, with real boxes and the machine's clock.
struct BenchedProgram {
    BenchedProgram(const char* appFolder, Visa& visa)
        : data(appFolder), session(visa, state, data, captions, clock, [] {}) {}

    [[nodiscard]] Surroundings surroundings() {
        return {session, state, data, captions, clock, dialogs, tickers, claim, QString(), QString(), [] {}};
    }

    SystemClock clock;
    DataFolder data;
    ProgramState state;
    Captions captions{data};
    QtDialogs dialogs{captions};
    Session session;
    TickerGroup tickers;
    const FolderClaim claim{data.path()};
};

}  // namespace kdx
