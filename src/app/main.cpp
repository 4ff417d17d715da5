// Options and wiring of the program; what there is to test stands elsewhere.
#include <QSocketNotifier>
#include <QStandardPaths>

#include <cstdio>
#include <cstdlib>
#include <string>
#include <vector>

#include "app/appfolder.h"
#include "app/choosevisa.h"
#include "app/options.h"
#include "app/platform.h"
#include "base/clock.h"
#include "base/paths.h"
#include "link/patientclock.h"
#include "link/workervisa.h"
#include "settings/captions.h"
#include "settings/datafolder.h"
#include "settings/folderlock.h"
#include "settings/leftovers.h"
#include "settings/programstate.h"
#include "settings/shippedfiles.h"
#include "settings/shownpath.h"
#include "sim/virtualinstrument.h"
#include "station/session.h"
#include "ui/application.h"
#include "ui/qtdialogs.h"
#include "ui/text.h"
#include "ui/ticker.h"
#include "window/hmenue.h"
#include "window/secondprogram.h"
#include "window/tour.h"
#include "window/viewstour.h"

namespace {

constexpr int kUsageError = 2;

void print(const std::string& line) {
    std::puts(line.c_str());
}

/// Ends the program when the operating system asks for it.
void endWhenAsked(kdx::Application& application) {
    const int requests = kdx::endRequests();
    if (requests < 0) return;
    auto* asked = new QSocketNotifier(requests, QSocketNotifier::Read, &application);
    QObject::connect(asked, &QSocketNotifier::activated, &application, [asked, &application] {
        asked->setEnabled(false);
        application.end();
    });
}

/// Lets the instrument go also when exit() ends the program, as Qt calls it when the display is lost: what main owns is
/// not destroyed then.
class EndsWithProgram {
public:
    EndsWithProgram(kdx::Session& session, kdx::WorkerVisa& worker) : m_session(session), m_worker(worker) {
        owned() = this;
        (void)std::atexit([] {
            if (owned() != nullptr) owned()->letGo();
        });
    }
    ~EndsWithProgram() { owned() = nullptr; }
    EndsWithProgram(const EndsWithProgram&) = delete;
    EndsWithProgram& operator=(const EndsWithProgram&) = delete;

private:
    void letGo() {
        m_worker.setWaiter(nullptr);  // the window can show nothing any more
        m_session.letGo();
    }
    static EndsWithProgram*& owned() {
        static EndsWithProgram* one = nullptr;
        return one;
    }

    kdx::Session& m_session;
    kdx::WorkerVisa& m_worker;
};

bool isFolder(const std::filesystem::path& folder) {
    std::error_code error;
    return std::filesystem::is_directory(folder, error);
}

/// Where the window's page and place are kept: what concerns this user's desktop is none of the instrument's settings.
std::filesystem::path placeFile() {
    const QString folder = QStandardPaths::writableLocation(QStandardPaths::GenericConfigLocation);
    return folder.isEmpty() ? std::filesystem::path()
                            : kdx::pathFromUtf8(folder.toStdString()) / "kdx-rds" / "window.ini";
}

/// Tries a last time to save what could not be, while there is still somebody to tell.
void saveTheRest(kdx::DataFolder& data) {
    data.retryUnsaved();
    if (const auto unsaved = data.unsavedFile())
        std::fprintf(stderr, "kdx-rds: what was changed last in %s could not be saved.\n", unsaved->c_str());
}

}  // namespace

int main(int argc, char** argv) {
    kdx::useTerminal();
    const kdx::Options options = kdx::parseOptions({argv + 1, argv + argc});
    if (!options.error.empty()) {
        std::fprintf(stderr, "kdx-rds: %s\nTry kdx-rds --help.\n", kdx::shownText(options.error).c_str());
        return kUsageError;
    }
    if (options.help) {
        std::fputs(kdx::helpText().c_str(), stdout);
        return EXIT_SUCCESS;
    }
    kdx::SystemClock systemClock;
    kdx::TourClock tourClock;  // in which pictures are always the same
    kdx::Clock& linkClock = options.views ? static_cast<kdx::Clock&>(tourClock) : systemClock;
    kdx::ChosenVisa link = kdx::chooseVisa(options, linkClock);
    if (options.version) {
        print("KDX-RDS " KDX_VERSION "\n" + link.description);
        return EXIT_SUCCESS;
    }
    if (!link.visa) {
        std::fprintf(stderr, "kdx-rds: %s\n", link.description.c_str());
        return EXIT_FAILURE;
    }
    if (options.appFolder && !isFolder(kdx::pathFromUtf8(*options.appFolder))) {
        std::fprintf(stderr, "kdx-rds: --app-folder: there is no folder %s\n",
                     kdx::shownText(*options.appFolder).c_str());
        return kUsageError;
    }
    if (!kdx::hasDisplay()) {
        if (!options.tourFolder) {
            std::fputs("kdx-rds: there is no display; --tour DIR works without one.\n", stderr);
            return EXIT_FAILURE;
        }
        qputenv("QT_QPA_PLATFORM", "offscreen");
    }

    kdx::Application application(argc, argv);
    endWhenAsked(application);
    kdx::DataNews news;
    kdx::DataFolder data(kdx::appFolder(options, argv[0], !options.tourFolder, news));
    if (!news.problem.empty()) std::fprintf(stderr, "kdx-rds: %s\n", news.problem.c_str());
    for (const auto& shipped : news.kept) std::fprintf(stderr, "kdx-rds: %s\n", kdx::keptFileText(shipped).c_str());
    if (!options.tourFolder) kdx::leaveTerminal();
    kdx::sweepLeftovers(data.path());
    const kdx::FolderClaim claim(data.path());
    kdx::ProgramState state;
    kdx::Captions captions(data);
    kdx::QtDialogs boxes(captions, [&application] { return application.isEnding(); });
    kdx::TourDialogs tourBoxes(print);
    kdx::Dialogs& dialogs = options.tourFolder ? static_cast<kdx::Dialogs&>(tourBoxes) : boxes;
    application.onFailure([&](const QString& doing, const QString& error) {
        dialogs.message(kdx::Dialogs::Icon::Critical, kdx::toText(captions.own(313, "Fehler")),
                        kdx::toText(captions.own(314, "Bei \"%1\": %2")).arg(doing, error));
    });
    if (options.tourFolder && claim.isShared()) data.setReadOnly();
    if (!options.tourFolder && !kdx::goesOnBesideAnother(claim, data, captions, dialogs)) return EXIT_SUCCESS;
    const auto end = [&application] { application.end(); };
    kdx::WorkerVisa worker(std::move(link.visa));
    kdx::PatientClock patientClock(worker);
    kdx::Clock& clock = options.views ? linkClock : patientClock;
    kdx::Session session(worker, state, data, captions, clock, end);
    const EndsWithProgram letGo(session, worker);
    kdx::TickerGroup tickers;
    kdx::HMenue window({session, state, data, captions, clock, dialogs, tickers, claim,
                        QString::fromStdString(link.description), QString::fromStdString(news.problem), end, &worker,
                        options.answerTime.value_or(std::chrono::seconds(2)), link.simulated != nullptr,
                        kdx::shippedAppFolder(argv[0]), options.tourFolder ? std::filesystem::path() : placeFile(),
                        news.kept});
    application.guarded(window.objectName(), [&] { window.startUp(); });
    if (options.tourFolder) {
        int result = EXIT_FAILURE;
        application.guarded(window.objectName(), [&] {
            const auto pictures = kdx::pathFromUtf8(*options.tourFolder);
            result = kdx::makeTour(window, session.instrument, tourBoxes, pictures, print);
            if (!options.views || result != EXIT_SUCCESS) return;
            const auto scenarios = kdx::shippedAppFolder(argv[0]) / "Daten" / "Scenarios";
            result = kdx::makeViewsTour(window, clock, tourBoxes, scenarios / "ta_switch_eon.yaml", pictures, print);
        });
        saveTheRest(data);
        return result;
    }
    if (application.isEnding()) return EXIT_SUCCESS;  // asked for while a box of the start was open
    window.show();
    const int result = kdx::Application::exec();
    saveTheRest(data);
    return result;
}
