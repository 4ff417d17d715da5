#include "onair/spectrumplot.h"

#include <QLabel>
#include <QPainter>

#include <algorithm>
#include <cmath>
#include <utility>

#include "onair/tables.h"
#include "ui/layouts.h"

namespace kdx {

namespace {

constexpr int kKilohertzOfLine = 10;
constexpr int kDecibelOfLine = 20;
constexpr double kHighestDecibel = 0;
// Of a longer time only so much is looked at: the end shows how it is now.
constexpr std::size_t kMostTaken = 6;

/// Where a value lies between two, in a range of pixels.
double placeOf(double value, double from, double to, double first, double last) {
    return first + (value - from) / (to - from) * (last - first);
}

}  // namespace

SpectrumPlot::SpectrumPlot(QWidget* parent) : QWidget(parent) {
    setSizePolicy(QSizePolicy::Expanding, QSizePolicy::Expanding);
}

QSize SpectrumPlot::minimumSizeHint() const {
    return {30 * fontMetrics().averageCharWidth(), 8 * fontMetrics().height()};
}

void SpectrumPlot::show(std::vector<double> decibels) {
    m_decibels = std::move(decibels);
    update();
}

void SpectrumPlot::paintEvent(QPaintEvent* /*event*/) {
    QPainter painter(this);
    const int left = fontMetrics().horizontalAdvance(QStringLiteral("-100 dB")) + 4;
    const QRect room =
        rect().adjusted(left, fontMetrics().height() / 2, -fontMetrics().horizontalAdvance(QStringLiteral("60")),
                        -fontMetrics().height() - 2);
    painter.fillRect(room, palette().color(QPalette::Base));
    drawScales(painter, room);
    painter.setClipRect(room);
    painter.setRenderHint(QPainter::Antialiasing);
    painter.setPen(QPen(palette().color(QPalette::Highlight), 1.2));
    painter.drawPolyline(curveIn(room));
}

void SpectrumPlot::drawScales(QPainter& painter, const QRect& room) const {
    const int height = fontMetrics().height();
    const auto lines = palette().color(QPalette::Midlight);
    const auto letters = palette().color(QPalette::WindowText);
    constexpr int kHighest = static_cast<int>(Spectrum::kHighestHertz / 1000);
    for (int kilohertz = 0; kilohertz <= kHighest; kilohertz += kKilohertzOfLine) {
        const int x = qRound(placeOf(kilohertz, 0, kHighest, room.left(), room.right()));
        painter.setPen(lines);
        painter.drawLine(x, room.top(), x, room.bottom());
        painter.setPen(letters);
        const QString text = kilohertz == 0 ? QStringLiteral("0 kHz") : QString::number(kilohertz);
        const int width = fontMetrics().horizontalAdvance(text);
        painter.drawText(x - width / 2, room.bottom() + height, text);
    }
    for (int decibel = 0; decibel >= static_cast<int>(Spectrum::kLowestDecibel); decibel -= kDecibelOfLine) {
        const int y = qRound(placeOf(decibel, kHighestDecibel, Spectrum::kLowestDecibel, room.top(), room.bottom()));
        painter.setPen(lines);
        painter.drawLine(room.left(), y, room.right(), y);
        if (decibel == static_cast<int>(Spectrum::kLowestDecibel)) continue;  // its place is the other scale's
        painter.setPen(letters);
        const QString text = decibel == 0 ? QStringLiteral("0 dB") : QString::number(decibel);
        painter.drawText(QRect(0, y - height / 2, room.left() - 4, height), Qt::AlignRight | Qt::AlignVCenter, text);
    }
}

/// The highest level at each pixel: a carrier is narrower than one.
QPolygonF SpectrumPlot::curveIn(const QRect& room) const {
    QPolygonF curve;
    for (std::size_t i = 0; i < m_decibels.size(); ++i) {
        const double hertz = static_cast<double>(i) * Spectrum::hertzOfStep();
        const double x = std::floor(placeOf(hertz, 0, Spectrum::kHighestHertz, room.left(), room.right()));
        const double y = placeOf(m_decibels[i], kHighestDecibel, Spectrum::kLowestDecibel, room.top(), room.bottom());
        if (!curve.isEmpty() && curve.last().x() == x) {
            curve.last().setY(std::min(curve.last().y(), y));
        } else {
            curve.append({x, y});
        }
    }
    return curve;
}

SpectrumFrame::SpectrumFrame(const PageContext& with, QWidget* parent) : QGroupBox(parent), m_with(with) {
    m_book.text(this, {780, "Spektrum des Multiplex, 0 dB = 75 kHz Hub"});
    Air_Spektrum = named<SpectrumPlot>("Air_Spektrum", this);
    m_book.spokenAs(Air_Spektrum, this);
    Air_Spitzenhub = named<QLabel>("Air_Spitzenhub", this);
    layOut(this, column({{Air_Spektrum, 1}, {Air_Spitzenhub, 0, Qt::AlignRight}}), 2);
}

void SpectrumFrame::label() {
    m_book.label(m_with.captions);
}

void SpectrumFrame::show(const air::Shadow& shadow) {
    const auto& sent = shadow.sent();
    const std::size_t fresh = std::min({static_cast<std::size_t>(shadow.count() - m_taken), sent.size(), kMostTaken});
    m_taken = shadow.count();
    for (std::size_t i = sent.size() - fresh; i < sent.size(); ++i) m_spectrum.take(sent[i]);
    if (fresh > 0) Air_Spektrum->show(m_spectrum.decibels());
    showText(Air_Spitzenhub, captionText(m_with.captions, {781, "Spitzenhub %1 kHz"})
                                 .arg(QString::number(m_spectrum.peakHertz() / 1000, 'f', 1)));
}

QString SpectrumFrame::text() const {
    return Air_Spitzenhub->text() + QLatin1Char('\n');
}

}  // namespace kdx
