// The program's editor of the event and location lists alone, with whatever lists the folder holds. Ends at its first
// paint. Usage: list_editor FOLDER
#include "base/clock.h"
#include "firstpaint.h"
#include "link/lanvisa.h"
#include "settings/captions.h"
#include "settings/datafolder.h"
#include "settings/programstate.h"
#include "station/session.h"
#include "tmc/tmclistedit.h"
#include "ui/application.h"
#include "ui/qtdialogs.h"
#include "ui/statusrow.h"
#include "ui/ticker.h"

int main(int argc, char** argv) {
    if (argc < 2) return 2;
    kdx::Application application(argc, argv);
    kdx::SystemClock clock;
    kdx::DataFolder data(argv[1]);
    kdx::ProgramState state;
    kdx::Captions captions(data);
    kdx::QtDialogs dialogs(captions);
    kdx::LanVisa visa;
    kdx::Session session(visa, state, data, captions, clock, [] {});
    kdx::TickerGroup tickers;
    kdx::StatusRow status(nullptr);
    kdx::TMC_Listedit editor(
        {session.params, session.instrument, session.profile, state, status, captions, dialogs, data, clock, tickers},
        nullptr);
    editor.show();
    return kdx::endAtFirstPaint(editor);
}
