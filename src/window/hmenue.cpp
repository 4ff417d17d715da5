#include "window/hmenue.h"

#include <QGroupBox>
#include <QHBoxLayout>
#include <QIcon>
#include <QMenu>
#include <QMouseEvent>
#include <QPushButton>
#include <QScrollBar>
#include <QShortcut>
#include <QStackedWidget>
#include <QTabBar>
#include <QTabWidget>

#include "af/afpage.h"
#include "af/eonpage.h"
#include "base/clock.h"
#include "groups/grouppage.h"
#include "rds/querypage.h"
#include "rds/rdspage.h"
#include "rds/storepage.h"
#include "rds/testmode.h"
#include "settings/captions.h"
#include "settings/datafolder.h"
#include "settings/programstate.h"
#include "stereo/rfpage.h"
#include "stereo/stereopage.h"
#include "tmc/tmcpage.h"
#include "ui/clickablelabel.h"
#include "ui/controls.h"
#include "ui/dialogs.h"
#include "window/logview.h"
#include "window/progressline.h"
#include "ui/statusrow.h"
#include "ui/text.h"
#include "ui/ticker.h"
#include "window/trafficlog.h"

#include <filesystem>

namespace kdx {

namespace {

constexpr int kGroupPage = 3;
constexpr int kQueryPage = 5;

/// Tells its layout no sizes of its own: the window's size is stated, and asking all nine pages what they need takes a
/// fifth of the whole start. That every page fits is the tests' concern.
class PageTabs : public QTabWidget {
public:
    explicit PageTabs(QWidget* parent) : QTabWidget(parent) {
        // Given a size, the stack of pages is not asked for its own at its first showing.
        findChild<QStackedWidget*>()->resize(parent->size());
    }
    [[nodiscard]] QSize sizeHint() const override { return {}; }
    [[nodiscard]] QSize minimumSizeHint() const override { return {}; }
};

// Captions of the pages as designed, in index order; some begin with a line feed to sit in the tab's second row.
constexpr std::array kPageCaptions = {"FM / Stereo", "\nR D S",   "AF Liste", "Gruppen", "\nE O N",
                                      "Fragen",      "Speichern", "\nT M C",  "\n* * *"};

}  // namespace

HMenue::HMenue(const Surroundings& surroundings)
    : m_s(surroundings),
      m_status(new StatusRow(this)),
      m_instrument(
          m_s.visa, m_s.state, m_s.data, m_s.clock,
          [this](const std::string& text, bool sequenceRuns) { return showInterfaceError(text, sequenceRuns); }),
      m_params(
          m_instrument, m_s.state, m_s.clock, [this] { return m_rds->clockText(); }, m_s.endProgram),
      m_context(new PageContext{m_params, m_instrument, m_s.state, *m_status, m_s.captions, m_s.dialogs, m_s.data,
                                m_s.clock}) {
    setObjectName(QStringLiteral("HMenue"));
    setWindowIcon(QIcon(QStringLiteral(":/kdx-rds-64.png")));
    m_trafficLog = new TrafficLog(this);
    m_instrument.onTraffic([this](const Traffic& traffic) { watchTraffic(traffic); });
    m_instrument.setCaptionSource([this](int number) { return m_s.captions.text(number); });
    createConnection();
    createPages();
    createMenu();
    arrange();
    m_s.data.onUnsavedFileChanged([this] { showNotice(); });
}

HMenue::~HMenue() {
    m_s.data.onUnsavedFileChanged(nullptr);
}

void HMenue::createConnection() {
    Frame8 = named<QGroupBox>("Frame8", this);
    INIT_Taste = named<QPushButton>("INIT_Taste", QStringLiteral("IEC &Bus INIT"), Frame8);
    connect(INIT_Taste, &QPushButton::clicked, this, &HMenue::INIT_Taste_Click);
    Label6 = named<QLabel>("Label6", QStringLiteral("Addr."), Frame8);
    Adr1_Label = named<ClickableLabel>("Adr1_Label", Frame8);
    Adr1_Label->setText(QStringLiteral("123.456.789.012"));
    Adr1_Label->setAlignment(Qt::AlignCenter);
    Adr1_Label->setMinimumWidth(Adr1_Label->fontMetrics().horizontalAdvance(QStringLiteral("000.000.000.000")) + 8);
    connect(Adr1_Label, &ClickableLabel::clicked, this, &HMenue::Adr1_Label_Click);
    Label6->setBuddy(Adr1_Label);
    Adr1_VScroll = named<QScrollBar>("Adr1_VScroll", Qt::Vertical, Frame8);
    Adr1_VScroll->hide();  // present without behaviour: the address is typed

    Ende_Taste = named<QPushButton>("Ende_Taste", QStringLiteral("&Ende"), this);
    connect(Ende_Taste, &QPushButton::clicked, this, &HMenue::Ende_Taste_Click);
    Image2 = named<QLabel>("Image2", this);
    Image2->setPixmap(QPixmap(QStringLiteral(":/banner.png")));
    Image2->setAlignment(Qt::AlignRight | Qt::AlignVCenter);
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
    SSTab1->tabBar()->setUsesScrollButtons(false);
    SSTab1->tabBar()->setExpanding(true);

    m_testMode = new TestMode(*m_context, nullptr);
    m_stereo = new StereoPage(*m_context, m_testMode, this);
    m_rds = new RdsPage(*m_context, this);
    m_af = new AfPage(*m_context, this);
    m_groups = new GroupPage(*m_context, this);
    m_eon = new EonPage(*m_context, this);
    m_queries = new QueryPage(*m_context, this);
    m_store = new StorePage(*m_context, this);
    m_tmc = new TmcPage(*m_context, this);
    m_rf = new RfPage(*m_context, this);
    const std::array<QWidget*, kPageCaptions.size()> pages = {m_stereo,  m_rds,   m_af,  m_groups, m_eon,
                                                              m_queries, m_store, m_tmc, m_rf};
    for (std::size_t i = 0; i < pages.size(); ++i) SSTab1->addTab(pages[i], QString::fromLatin1(kPageCaptions[i]));
    connect(SSTab1, &QTabWidget::currentChanged, this, &HMenue::SSTab1_Click);
    // While no session is open the pages can be looked at, though not used.
    SSTab1->tabBar()->installEventFilter(this);
    for (const int step : {1, -1}) {
        auto* shortcut = new QShortcut(step > 0 ? Qt::CTRL | Qt::Key_PageDown : Qt::CTRL | Qt::Key_PageUp, this);
        connect(shortcut, &QShortcut::activated, this, [this, step] {
            SSTab1->setCurrentIndex((SSTab1->currentIndex() + step + SSTab1->count()) % SSTab1->count());
        });
    }

    connect(m_stereo, &StereoPage::setRdsStereoRequested, this, &HMenue::SetRdsStereo);
}

void HMenue::arrange() {
    auto* connection = new QHBoxLayout(Frame8);
    tighten(connection);
    connection->addWidget(INIT_Taste);
    connection->addWidget(Label6);
    connection->addWidget(Adr1_Label);
    connection->addWidget(Adr1_VScroll);
    auto* top = new QHBoxLayout;
    top->setSpacing(8);
    top->addWidget(Frame8);
    top->addWidget(Ende_Taste);
    top->addStretch();
    top->addWidget(Image2);

    auto* parameters = new QVBoxLayout(Frame7);
    parameters->setContentsMargins(0, 0, 0, 0);
    parameters->addWidget(SSTab1);

    m_lowerEdge = new ProgressLine(this);

    auto* middle = new QWidget(this);
    auto* column = new QVBoxLayout(middle);
    column->setContentsMargins(6, 2, 6, 2);
    column->setSpacing(3);
    column->addLayout(top);
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

void HMenue::Beschrifter() {
    m_s.state.language = generalSetting("Sprache", "Sprache");
    // Before a language was ever chosen the window speaks the one it was designed in.
    if (m_s.state.language.empty()) m_s.state.language = "deutsch";
    m_s.state.standard = generalSetting("Sprache", "RDS_RBDS");
    m_s.captions.load(m_s.state.language, m_s.state.standard);
    const Captions& captions = m_s.captions;

    labelMenu();
    Ende_Taste->setText(toText(captions.text(6)));
    GTL_Taste->setText(toText(captions.own(300, "Local")));
    Label6->setText(toText(captions.own(308, "Addr.")));
    Adr1_Label->setAccessibleName(toText(captions.own(319, "Adresse des Ger\xE4ts")));
    for (int i = 0; i < SSTab1->count(); ++i) SSTab1->setTabText(i, toText(captions.text(10 + i)));
    SSTab1->setCurrentIndex(0);
    m_status->label(captions);
    m_stereo->label();
    m_testMode->label();
    m_rds->label();
    m_af->label();
    m_groups->label();
    m_eon->label();
    m_queries->label();
    m_store->label();
    m_tmc->label();
    m_rf->label();
    m_trafficLog->label(captions);
    if (m_logView != nullptr) m_logView->label(captions);
    showNotice();
}

void HMenue::SSTab1_Click(int page) {
    if (page == kGroupPage) {
        m_groups->pageOpened();
        // Not the pages the editor is opened from: its buttons set the kind themselves.
        m_s.state.afEditorKind = "AF";
    } else if (page == kQueryPage) {
        m_s.state.afEditorKind = "EON AF";
    }
}

void HMenue::Ende_Taste_Click() {
    m_s.endProgram();  // every setting was stored when it changed
}

void HMenue::showNotice() {
    const Captions& captions = m_s.captions;
    QStringList notes;
    if (const QString missing = missingData(); !missing.isEmpty()) {
        notes += toText(captions.own(322, "Nicht gefunden: %1")).arg(missing);
    } else if (!m_startNotice.isEmpty()) {
        notes += m_startNotice;
    }
    if (const auto unsaved = m_s.data.unsavedFile()) {
        notes += toText(captions.own(312, "Nicht gespeichert: %1")).arg(toText(*unsaved));
    }
    m_lowerEdge->setNotice(notes.join(QStringLiteral("  -  ")));
}

QString HMenue::missingData() const {
    const std::filesystem::path& folder = m_s.data.path();
    std::error_code error;
    if (!std::filesystem::is_directory(folder, error)) return QString::fromStdU16String(folder.u16string());
    // Missing, unreadable, garbage, or without this language: the captions are empty all the same.
    if (m_s.captions.isEmpty())
        return QStringLiteral("%1 [%2]").arg(QLatin1String(kLanguageFile), toText(m_s.state.language));
    return {};
}

bool HMenue::showInterfaceError(const std::string& text, bool sequenceRuns) {
    // While the box waits, timers would send more to the same broken link and pile up more boxes.
    holdTimers(true);
    const QString title = QStringLiteral("Interface Error");
    bool stop = false;
    if (sequenceRuns) {
        stop = m_s.dialogs.messageOrStop(title, toText(text));
    } else {
        m_s.dialogs.message(Dialogs::Icon::Critical, title, toText(text));
    }
    holdTimers(false);
    return stop;
}

void HMenue::holdTimers(bool held) {
    for (Ticker* ticker : findChildren<Ticker*>()) ticker->setHeld(held);
}

void HMenue::watchTraffic(const Traffic& traffic) {
    if (traffic.kind == Traffic::Kind::Written) m_lowerEdge->step();
    m_trafficLog->add(traffic, m_s.clock.secondsSinceMidnight());
    emit trafficPassed(traffic);
}

QString HMenue::progressPattern() const {
    return toText(m_s.captions.own(324, "Sende Befehl %1 von %2"));
}

std::string HMenue::generalSetting(const char* section, const char* key) const {
    return m_s.data.ReadIni(section, key, kGeneralSettings);
}

}  // namespace kdx
