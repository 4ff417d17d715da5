#include "onair/onairview.h"

#include <QClipboard>
#include <QFile>
#include <QGuiApplication>
#include <QLabel>
#include <QPushButton>
#include <QScreen>
#include <QShowEvent>
#include <QTimer>

#include <algorithm>

#include "air/multiplexfile.h"
#include "air/shadow.h"
#include "onair/budgettable.h"
#include "onair/groupmonitor.h"
#include "onair/radioface.h"
#include "onair/radiotables.h"
#include "onair/spectrumplot.h"
#include "ui/layouts.h"
#include "ui/savefile.h"

namespace kdx {

namespace {

constexpr int kIntervalMs = 250;

/// The groups among what went out, as the lines of a group log.
QByteArray groupLog(const std::deque<air::Sent>& sent) {
    QByteArray lines;
    for (const air::Sent& one : sent) {
        if (one.what.kind == air::OnAir::Kind::Group)
            lines += QByteArray::fromStdString(air::logLine(one.what.group, one.end)) + '\n';
    }
    return lines;
}

bool saveMultiplex(const std::deque<air::Sent>& sent, const QString& name) {
    const auto length = air::kGroupTime * static_cast<std::int64_t>(sent.size());
    air::MultiplexFile file(QFile::encodeName(name).toStdString(), air::kMultiplexRate, air::SampleFormat::Float,
                            length);
    for (const air::Sent& one : sent) file.add(one.what, *one.settings);
    return file.close();
}

/// Where both windows can be seen, if the screen has room for them side by side; else where it is.
void moveBeside(QWidget& view, const QWidget* window) {
    if (window == nullptr) return;
    const QRect screen = window->screen()->availableGeometry();
    const QRect taken = window->frameGeometry();
    const int y = std::clamp(taken.top(), screen.top(), std::max(screen.top(), screen.bottom() - view.height()));
    if (taken.right() + view.width() < screen.right()) {
        view.move(taken.right() + 1, y);
    } else if (taken.left() - view.width() > screen.left()) {
        view.move(taken.left() - view.width() - 1, y);
    }
}

}  // namespace

OnAirView::OnAirView(air::Shadow& shadow, const Station& station, const PageContext& with, QWidget* parent)
    : QDialog(parent), m_shadow(shadow), m_station(station), m_with(with) {
    setObjectName(QStringLiteral("OnAirView"));
    m_book.text(this, {720, "Auf Sendung"});
    m_timer = named<QTimer>("AirTimer", this);
    m_timer->setInterval(kIntervalMs);
    connect(m_timer, &QTimer::timeout, this, &OnAirView::AirTimer_Timer);
    m_face = new RadioFace(with, this);
    m_tables = new RadioTables(with, this);
    m_groups = new GroupMonitor(with, this);
    m_budget = new BudgetTable(with, this);
    m_spectrum = new SpectrumFrame(with, this);
    const auto button = [this](const char* name, const Caption& caption, void (OnAirView::*handler)()) {
        auto* made = m_book.captioned<QPushButton>(name, caption, this);
        made->setAutoDefault(false);
        connect(made, &QPushButton::clicked, this, handler);
        return made;
    };
    Air_Gruppen_Sichern =
        button("Air_Gruppen_Sichern", {785, "&Gruppen sichern..."}, &OnAirView::Air_Gruppen_Sichern_Click);
    m_book.tip(Air_Gruppen_Sichern, {783, "Die letzten Gruppen als Textdatei, eine je Zeile"});
    Air_MPX_Sichern = button("Air_MPX_Sichern", {786, "&Multiplex sichern..."}, &OnAirView::Air_MPX_Sichern_Click);
    m_book.tip(Air_MPX_Sichern, {784, "Das Multiplexsignal zu den letzten Gruppen als WAV-Datei"});
    Air_Kopieren = button("Air_Kopieren", {686, "&Kopieren"}, &OnAirView::Air_Kopieren_Click);
    m_book.tip(Air_Kopieren, {1141, "Legt alles Gezeigte als Text in die Zwischenablage"});
    Air_Schliessen = m_book.captioned<QPushButton>("Air_Schliessen", {688, "&Schließen"}, this);
    m_book.tip(Air_Schliessen, {1121, "Schließt nur diese Ansicht; was läuft, läuft weiter"});
    Air_Schliessen->setAutoDefault(false);
    connect(Air_Schliessen, &QPushButton::clicked, this, &QDialog::close);
    arrange();
    label();
    Air_Kopieren->setFocus();  // the texts of the radio would show a caret otherwise
}

void OnAirView::arrange() {
    auto* note = m_book.captioned<QLabel>(
        "Air_Hinweis",
        {721, "Gezeigt wird, was der virtuelle Coder aus den Befehlen macht; das Gerät selbst wird nicht gehört."},
        this);
    auto* columns = row({column({m_face, {m_tables, 1}}), column({m_groups, {m_spectrum, 1}, {m_budget, 2}})});
    layOut(
        this,
        column({note, {columns, 1}, row({Air_Gruppen_Sichern, Air_MPX_Sichern, Air_Kopieren, kRoom, Air_Schliessen})}),
        6);
    // In letters, so that it is the same on every display, if that has room for it.
    const QSize wanted(fontMetrics().averageCharWidth() * 150, fontMetrics().height() * 50);
    resize(wanted.boundedTo(screen()->availableGeometry().size() * 9 / 10));
}

void OnAirView::label() {
    m_book.label(m_with.captions);
    m_face->label();
    m_tables->label();
    m_groups->label();
    m_budget->label();
    m_spectrum->label();
    if (isVisible()) AirTimer_Timer();
}

void OnAirView::forgetTexts() {
    m_tables->forgetTexts();
}

void OnAirView::showEvent(QShowEvent* event) {
    if (!event->spontaneous()) {
        if (m_place) {
            move(*m_place);
        } else {
            moveBeside(*this, parentWidget());
        }
    }
    m_shadow.setWatched(true);
    AirTimer_Timer();
    m_timer->start();
    QDialog::showEvent(event);
}

void OnAirView::hideEvent(QHideEvent* event) {
    if (!event->spontaneous()) m_place = pos();
    m_timer->stop();
    m_shadow.setWatched(false);
    QDialog::hideEvent(event);
}

void OnAirView::AirTimer_Timer() {
    m_shadow.catchUp();
    m_face->show(m_shadow, m_station);
    m_tables->show(m_shadow, m_station);
    m_groups->show(m_shadow);
    m_budget->show(m_shadow);
    m_spectrum->show(m_shadow);
    Air_Gruppen_Sichern->setEnabled(!m_shadow.types().empty());
    Air_MPX_Sichern->setEnabled(!m_shadow.sent().empty() && m_shadow.transmission().settings.stereoOn);
}

void OnAirView::Air_Gruppen_Sichern_Click() {
    // What is kept goes on while the box is open; meant is what was there at the click.
    saveToChosenFile(m_with, windowTitle(), "groups.txt", {787, "Gruppen (*.txt)"},
                     [sent = m_shadow.sent()](const QString& file) { return replaceWith(groupLog(sent), file); });
}

void OnAirView::Air_MPX_Sichern_Click() {
    saveToChosenFile(m_with, windowTitle(), "multiplex.wav", {788, "Multiplex (*.wav)"},
                     [sent = m_shadow.sent()](const QString& file) { return saveMultiplex(sent, file); });
}

void OnAirView::Air_Kopieren_Click() {
    const QStringList parts{m_face->text(), m_tables->text(), m_groups->text(), m_budget->text(), m_spectrum->text()};
    QGuiApplication::clipboard()->setText(parts.join(QLatin1Char('\n')));
}

}  // namespace kdx
