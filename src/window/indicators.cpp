#include "window/indicators.h"

#include <QPainter>

#include <algorithm>
#include <array>

#include "link/instrument.h"
#include "ui/caption.h"
#include "ui/clickablelabel.h"
#include "ui/statusrow.h"
#include "window/connectionbar.h"
#include "window/datasets.h"

namespace kdx {

namespace {

/// A dot in the colour of the connection. Its shape tells lost from open too, for whoever sees no red.
class Dot final : public QWidget {
public:
    using QWidget::QWidget;

    void show(const QColor& color, bool filled) {
        m_color = color;
        m_filled = filled;
        update();
    }
    [[nodiscard]] QSize sizeHint() const override { return {kSize, kSize}; }

protected:
    void paintEvent(QPaintEvent* /*event*/) override {
        QPainter painter(this);
        painter.setRenderHint(QPainter::Antialiasing);
        painter.setPen(QPen(m_color.darker(), 1.5));
        painter.setBrush(m_filled ? QBrush(m_color) : QBrush(Qt::NoBrush));
        const QRectF place(0, 0, kSize, kSize);
        painter.drawEllipse(place.translated(rect().center() - place.center().toPoint()).adjusted(1, 1, -1, -1));
    }

private:
    static constexpr int kSize = 12;
    QColor m_color = Qt::gray;
    bool m_filled = false;
};

/// The commands that switch the RF output.
constexpr std::array kOutputs = {":OUTPUT:STAT OFF", ":OUTPUT:STAT ON"};

/// What says that there is nobody at the other end. A call that was stopped, a device that another program holds and
/// one that is slow to answer do not.
constexpr std::array kLosses = {visa::kConnectionLost, visa::kInputOutput, visa::kResourceNotFound,
                                visa::kInvalidObject,  visa::kSystemError, visa::kNoListeners};

}  // namespace

Indicators::Indicators(const PageContext& with, const DataSets& sets, ConnectionBar& bar, bool simulated,
                       QObject* parent)
    : QObject(parent), m_with(with), m_sets(sets), m_bar(bar), m_simulated(simulated) {
    constexpr int kSetWidth = 4;
    constexpr int kOutputWidth = 3;
    StatusRow& row = m_with.status;
    m_setHeading = new QLabel(&row);
    Datensatz_Anzeige = named<ClickableLabel>("Datensatz_Anzeige", &row);
    row.add(StatusRow::Place::Front, m_setHeading, Datensatz_Anzeige, kSetWidth);
    m_outputHeading = new QLabel(&row);
    HF_Anzeige = named<QLabel>("HF_Anzeige", &row);
    row.add(StatusRow::Place::BesideLevel, m_outputHeading, HF_Anzeige, kOutputWidth);
    Verbindung_Marke = named<Dot>("Verbindung_Marke", &row);
    row.addMark(Verbindung_Marke);
    m_with.instrument.addWatcher(*this);
}

Indicators::~Indicators() {
    m_with.instrument.removeWatcher(*this);
}

void Indicators::label() {
    m_setHeading->setText(captionText(m_with.captions, {903, "Satz"}));
    m_outputHeading->setText(captionText(m_with.captions, {911, "HF"}));
    HF_Anzeige->setAccessibleName(m_outputHeading->text());
    showDataSet();
    showConnection();
    showOutput();
}

void Indicators::passed(const Traffic& traffic) {
    if (traffic.kind == Traffic::Kind::Logged) return;
    const bool failed = traffic.status < 0;
    if (!failed) m_lost = false;
    if (std::find(kLosses.begin(), kLosses.end(), traffic.status) != kLosses.end()) m_lost = true;
    showConnection();
    for (std::size_t i = 0; i < kOutputs.size() && !failed; ++i) {
        if (traffic.text != kOutputs[i]) continue;
        m_output = i == 0 ? Output::Off : Output::On;
        showOutput();
    }
}

void Indicators::showSessionOpen(bool open) {
    m_open = open;
    if (!open) m_lost = false;
    showConnection();
}

void Indicators::showDataSet() {
    Datensatz_Anzeige->setText(m_sets.shown());
    const QString tip =
        captionText(m_with.captions,
                    {904, "Der geladene Datensatz; was geändert wird, wird in ihm gespeichert. Ein Klick zeigt alle."});
    Datensatz_Anzeige->setToolTip(m_sets.number() > 0 ? tip : m_sets.shown() + QLatin1Char('\n') + tip);
    Datensatz_Anzeige->setAccessibleName(m_setHeading->text() + QLatin1Char(' ') + m_sets.shown());
}

QString Indicators::connection() const {
    const auto text = [this](const Caption& caption) { return captionText(m_with.captions, caption); };
    if (!m_open) return text({912, "nicht verbunden"});
    if (m_lost) return text({914, "Verbindung verloren"});
    if (m_simulated) return text({915, "simuliert"});
    return text({913, "verbunden: %1"}).arg(m_bar.openAddress());
}

void Indicators::showConnection() {
    const QString words = connection();
    m_bar.showConnection(words);
    const QColor color = !m_open ? QColor(Qt::gray) : m_lost ? QColor(Qt::red) : QColor(0x3C, 0xB3, 0x71);
    static_cast<Dot*>(Verbindung_Marke)->show(color, m_open && !m_lost);
    Verbindung_Marke->setToolTip(words);
    Verbindung_Marke->setAccessibleName(words);
}

void Indicators::showOutput() {
    constexpr int kOn = 192;
    constexpr int kOff = 193;
    HF_Anzeige->setText(m_output == Output::Unknown
                            ? QStringLiteral("--")
                            : captionText(m_with.captions, {m_output == Output::On ? kOn : kOff}));
}

}  // namespace kdx
