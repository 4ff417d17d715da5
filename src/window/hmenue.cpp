#include "window/hmenue.h"

#include <QCloseEvent>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QIcon>
#include <QMouseEvent>
#include <QPushButton>
#include <QScopeGuard>
#include <QShortcut>
#include <QTabBar>
#include <QTabWidget>
#include <QTimer>

#include <chrono>

#include "link/commandsequence.h"
#include "settings/captions.h"
#include "settings/datafolder.h"
#include "settings/generalsettings.h"
#include "settings/programstate.h"
#include "settings/storedvalue.h"
#include "tmc/tmclistedit.h"
#include "ui/controls.h"
#include "ui/dialogs.h"
#include "ui/page.h"
#include "ui/pictureswitch.h"
#include "ui/plaintext.h"
#include "ui/statusrow.h"
#include "ui/text.h"
#include "ui/ticker.h"
#include "window/connectionbar.h"
#include "window/desktop.h"
#include "window/mainmenu.h"
#include "window/notes.h"
#include "window/pages.h"
#include "window/pagetabs.h"
#include "window/progressline.h"
#include "window/views.h"
#include "window/waysout.h"
#include "window/windowsize.h"

namespace kdx {

namespace {

constexpr std::chrono::seconds kRetryInterval{10};  // until what could not be saved is tried again

}  // namespace

HMenue::HMenue(const Surroundings& surroundings)
    : m_s(surroundings),
      m_status(new StatusRow(this)),
      m_marks(m_s.session.params, m_s.session.instrument, m_s.state, m_s.captions),
      m_context{m_s.session.params,
                m_s.session.instrument,
                m_s.session.profile,
                m_s.state,
                *m_status,
                m_s.captions,
                m_s.dialogs,
                m_s.data,
                m_s.clock,
                m_s.tickers,
                m_marks} {
    setObjectName(QStringLiteral("HMenue"));
    setWindowIcon(QPixmap(QStringLiteral(":/kdx-rds-64.png")));  // read once for all that show it
    m_views = std::make_unique<Views>(
        m_context, m_s.session, this,
        [this] {
            m_s.session.load();
            const CommandSequence silent(m_s.session.instrument);  // what is shown anew is no setting that goes out
            m_s.session.instrument.stopSequence();
            loadPages();
        },
        m_s.shipped.empty() ? m_s.shipped : m_s.shipped / "Daten" / "Scenarios");
    m_connection = new ConnectionBar(m_context, this);
    connect(m_connection, &ConnectionBar::openRequested, this, &HMenue::INIT_Taste_Click);
    // Every setting was stored when it changed: nothing is left to do at the end.
    connect(m_connection, &ConnectionBar::endRequested, this, [this] { m_s.endProgram(); });
    createPages();
    watchPictures();
    createMenu();
    arrange();
    m_s.session.transmitter.setWatcher(this);
    const auto changed = [this] { showNotice(); };
    m_s.data.onUnsavedFileChanged(changed);
    m_s.session.instrument.log.onChange(changed);
    m_s.session.params.onQuotedKeysChanged(changed);
    auto* retry = named<QTimer>("UnsavedTimer", this);
    connect(retry, &QTimer::timeout, this, [this] {
        m_s.data.retryUnsaved();
        m_s.session.instrument.log.retry();
        for (PictureSwitch* button : findChildren<PictureSwitch*>()) button->tryAgain();
        showNotice();  // another program on the same data comes and goes
    });
    retry->start(kRetryInterval);
}

HMenue::~HMenue() {
    m_views->endScenario();
    m_s.session.transmitter.setWatcher(nullptr);
    m_s.data.onUnsavedFileChanged(nullptr);
    m_s.session.instrument.log.onChange(nullptr);
    m_s.session.params.onQuotedKeysChanged(nullptr);
    m_s.data.retryUnsaved();  // a last time
}

void HMenue::createPages() {
    Frame7 = named<QGroupBox>("Frame7", this);
    SSTab1 = named<PageTabs>("SSTab1", Frame7);
    auto* corner = new QWidget(SSTab1);
    auto* cornerLayout = new QHBoxLayout(corner);
    cornerLayout->setContentsMargins(0, 0, 0, 1);
    GTL_Taste = named<QPushButton>("GTL_Taste", QStringLiteral("Local"), corner);
    cornerLayout->addWidget(GTL_Taste);
    connect(GTL_Taste, &QPushButton::clicked, this, &HMenue::GTL_Taste_Click);
    GTL_Taste->setFixedWidth(GTL_Taste->fontMetrics().horizontalAdvance(QStringLiteral("Local")) + 28);
    SSTab1->setCornerWidget(corner);

    for (const PageRow& row : pageRows()) {
        m_pages.push_back(row.make(m_context, m_s.session.station, *this));
        SSTab1->addTab(m_pages.back(), QString());
    }
    connect(SSTab1, &QTabWidget::currentChanged, this, &HMenue::SSTab1_Click);
    // While no session is open the pages can be looked at, though not used.
    SSTab1->tabBar()->installEventFilter(this);
    for (const int step : {1, -1}) {
        auto* shortcut = new QShortcut(step > 0 ? Qt::CTRL | Qt::Key_PageDown : Qt::CTRL | Qt::Key_PageUp, this);
        connect(shortcut, &QShortcut::activated, this, [this, step] {
            SSTab1->setCurrentIndex((SSTab1->currentIndex() + step + SSTab1->count()) % SSTab1->count());
        });
    }
}

void HMenue::watchPictures() {
    // Queued: a picture is loaded while its switch is painted, when no other control may change.
    for (const PictureSwitch* button : findChildren<PictureSwitch*>())
        connect(button, &PictureSwitch::brokenPictureChanged, this, &HMenue::showNotice, Qt::QueuedConnection);
}

void HMenue::createMenu() {
    m_menu = new MainMenu(m_context, m_s.linkDescription, this);
    connect(m_menu, &MainMenu::interfaceChosen, m_connection, &ConnectionBar::chooseInterface);
    connect(m_connection, &ConnectionBar::interfaceShown, m_menu, &MainMenu::showInterface);
    connect(m_menu, &MainMenu::relabelRequested, this, &HMenue::Beschrifter);
    connect(m_menu, &MainMenu::listEditorRequested, this, &HMenue::Mnu_TMC_Edit_Click);
    m_desktop = std::make_unique<Desktop>(m_s, m_context, *m_connection, *SSTab1, this);
    m_desktop->createMenus(*m_menu, *m_views);
    connect(m_desktop.get(), &Desktop::relabelRequested, this, &HMenue::Beschrifter);
    connect(m_desktop.get(), &Desktop::readAllRequested, this, [this] {
        if (SSTab1->isEnabled()) emit readAllRequested();
    });
    connect(m_desktop.get(), &Desktop::sendRequested, this, &HMenue::SetRdsStereo);
    connect(m_desktop.get(), &Desktop::dataSetLoaded, this, [this] {
        for (Page* page : m_pages) page->showDataSet();
    });
}

void HMenue::arrange() {
    auto* parameters = new QVBoxLayout(Frame7);
    parameters->setContentsMargins(0, 0, 0, 0);
    parameters->addWidget(SSTab1);
    m_lowerEdge = new ProgressLine(this);
    m_waysOut = new WaysOut(m_s, *m_lowerEdge, this);
    m_waysOut->letTakeFailures([this] { return m_views->takesFailure(); });
    connect(m_waysOut, &WaysOut::givenUp, this, [this] { m_views->stopScenario(); });
    connect(m_waysOut, &WaysOut::localRequested, this, &HMenue::GTL_Taste_Click);
    auto* middle = new QWidget(this);
    auto* column = new QVBoxLayout(middle);
    column->setContentsMargins(6, 2, 6, 2);
    column->setSpacing(3);
    column->addWidget(m_connection);
    column->addWidget(Frame7, 1);
    column->addWidget(m_status);
    column->addWidget(m_lowerEdge);
    setCentralWidget(middle);
}

bool HMenue::eventFilter(QObject* watched, QEvent* event) {
    if (event->type() == QEvent::MouseButtonPress && watched == SSTab1->tabBar() && !SSTab1->isEnabled()) {
        const int page = SSTab1->tabBar()->tabAt(static_cast<QMouseEvent*>(event)->pos());
        if (page >= 0) SSTab1->setCurrentIndex(page);
        return true;
    }
    return QMainWindow::eventFilter(watched, event);
}

void HMenue::startUp() {
    const Profile& profile = m_s.session.profile;
    // The two blanks before the slash and at the end belong to the title.
    m_s.state.ProgramTitle = "KDX-RDS V 1.0  / Mar. 2009  ";
    setWindowTitle(toText(m_s.state.ProgramTitle));
    fitToFont(*this, *SSTab1);
    m_s.state.InterfaceKind = profile.read(setting::kInterface);
    m_connection->Schnittstellen_Toggle();
    m_s.state.InstrumentOnline = false;
    m_s.state.LogEnabled = isSwitchedOn(profile.read(setting::kCommandLogOn));
    showSessionOpen(false);
    Beschrifter();
    m_s.state.CurrentDataSet = "1";
    m_s.session.load();
    setProperty(kQuotesDoubled, m_s.state.corrections.quotes);
    loadPages();
    m_desktop->restorePlace();
    m_s.session.instrument.log.empty();
    if (opensAtStart(profile.read(setting::kOpenAtStart))) INIT_Taste_Click();
}

void HMenue::loadPages() {
    for (Page* page : m_pages) {
        try {
            page->load();
        } catch (const std::exception& error) {
            m_startNotice = QString::fromUtf8(error.what());  // the page goes on with what it has
        }
    }
    showNotice();
}

void HMenue::Beschrifter() {
    m_s.state.language = languageOrDesign(m_s.session.profile.read(setting::kLanguage));
    m_s.state.standard = m_s.session.profile.read(setting::kStandard);
    m_s.captions.load(m_s.state.language, m_s.state.standard);
    m_menu->label();
    m_connection->label();
    m_desktop->label();
    GTL_Taste->setText(captionText(m_s.captions, {300, "Local"}));
    int tab = 0;
    for (const PageRow& row : pageRows()) SSTab1->setTabText(tab++, captionText(m_s.captions, {row.tabCaption}));
    SSTab1->setCurrentIndex(0);
    m_status->label(m_s.captions);
    m_waysOut->label();
    for (Page* page : m_pages) page->label();
    m_views->label();
    m_marks.refresh();
    m_desktop->showTips();
    showNotice();
}

void HMenue::INIT_Taste_Click() {
    Session& session = m_s.session;
    m_s.state.InterfaceKind = session.profile.read(setting::kInterface);
    const CommandSequence run(session.instrument);  // the opening can be stopped, too
    m_lowerEdge->showWait(captionText(m_s.captions, {1256, "Wartet auf %1"}).arg(m_connection->openAddress()));
    const auto over = qScopeGuard([this] { m_lowerEdge->endProgress(); });
    const VisaStatus status = session.open(m_s.state.InterfaceKind, m_connection->address());
    if (status != 0) {
        m_lowerEdge->endProgress();
        m_waysOut->tellOpening(status);
        return;
    }
    session.sendOpening();
}

void HMenue::showPage(Page& page) {
    SSTab1->setCurrentWidget(&page);
}

void HMenue::SetRdsStereo() {
    m_s.session.sendDataSet();
}

void HMenue::GTL_Taste_Click() {
    m_views->endScenario();
    m_s.session.close();
    // Only the switched-off pages and the resting timers keep commands away from the closed handle.
    showSessionOpen(false);
    setWindowTitle(toText(m_s.state.ProgramTitle));
    m_s.tickers.setHeld(true);
}

void HMenue::stepGoesOut(const Step& step, std::size_t number, std::size_t total) {
    m_outcome.next(step);
    if (number > 0) {
        m_lowerEdge->showProgress(captionText(m_s.captions, {324, "Sende Befehl %1 von %2"}), number, total);
    }
    if (m_views->scenarioSends()) return;  // the pages show what the window has
    // A refused step shows a box: no timer may change meanwhile what the steps after it were made of.
    if (step.kind == Step::Kind::Refused) m_s.tickers.setHeld(true);
    for (Page* page : m_pages) page->stepGoesOut(step);
    if (step.kind == Step::Kind::Refused) m_s.tickers.setHeld(false);
}

void HMenue::stepLeftOut(const Step& step) {
    if (!m_views->scenarioSends()) m_marks.leftOut(step.key, step.value);
}

void HMenue::stepAnswered(const Step& step, const std::string& answer) {
    if (step.kind != Step::Kind::Identify) return;
    setWindowTitle(withBlanks(toText(answer)));
    m_s.tickers.setHeld(false);
    showSessionOpen(true);
}

void HMenue::stepsEnded() {
    m_outcome.settle();
    m_lowerEdge->endProgress();
}

void HMenue::showSessionOpen(bool open) {
    if (open) emit sessionOpened();
    SSTab1->setEnabled(open);
    Frame7->setEnabled(open);
    m_connection->showSessionOpen(open);
    m_menu->showSessionOpen(open);
    m_desktop->showSessionOpen(open);
    m_views->showSessionOpen(open);
}

void HMenue::closeEvent(QCloseEvent* event) {
    event->setAccepted(m_waysOut->mayClose());
}

void HMenue::SSTab1_Click(int page) {
    if (page < 0) return;
    m_pages.at(static_cast<std::size_t>(page))->opened();
    if (const char* lists = pageRows()[static_cast<std::size_t>(page)].afLists) m_s.state.afEditorKind = lists;
}

void HMenue::Mnu_TMC_Edit_Click() {
    TMC_Listedit editor(m_context, this);
    editor.exec();
    m_views->forgetTexts();
    emit listsEdited();
}

void HMenue::showNotice() {
    m_lowerEdge->setNotice(notes(m_s, *this, m_startNotice).join(QStringLiteral("  -  ")));
}

}  // namespace kdx
