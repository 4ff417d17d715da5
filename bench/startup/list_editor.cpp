// The program's editor of the event and location lists alone, with whatever lists the folder holds. Ends at its first
// paint. Usage: list_editor FOLDER
#include "benchedprogram.h"
#include "firstpaint.h"
#include "link/lanvisa.h"
#include "tmc/tmclistedit.h"
#include "ui/application.h"
#include "ui/keymarks.h"
#include "ui/statusrow.h"

int main(int argc, char** argv) {
    if (argc < 2) return 2;
    kdx::Application application(argc, argv);
    kdx::LanVisa visa;
    kdx::BenchedProgram program(argv[1], visa);
    kdx::Session& session = program.session;
    kdx::StatusRow status(nullptr);
    kdx::KeyMarks marks(session.params, session.instrument, program.state, program.captions);
    kdx::TMC_Listedit editor({session.params, session.instrument, session.profile, program.state, status,
                              program.captions, program.dialogs, program.data, program.clock, program.tickers, marks},
                             nullptr);
    editor.show();
    return kdx::endAtFirstPaint(editor);
}
