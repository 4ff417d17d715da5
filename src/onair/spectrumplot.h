#pragma once

#include <QGroupBox>
#include <QPolygonF>

#include <cstdint>
#include <vector>

#include "onair/spectrum.h"
#include "ui/caption.h"
#include "ui/pagecontext.h"

class QLabel;

namespace kdx {

/// Draws levels over 0 to 60 kHz.
class SpectrumPlot final : public QWidget {
public:
    explicit SpectrumPlot(QWidget* parent);
    void show(std::vector<double> decibels);
    [[nodiscard]] const std::vector<double>& decibels() const { return m_decibels; }
    [[nodiscard]] QSize minimumSizeHint() const override;

protected:
    void paintEvent(QPaintEvent* event) override;

private:
    void drawScales(QPainter& painter, const QRect& room) const;
    [[nodiscard]] QPolygonF curveIn(const QRect& room) const;

    std::vector<double> m_decibels;
};

/// The spectrum of the multiplex and its peak deviation.
class SpectrumFrame : public QGroupBox {
public:
    SpectrumFrame(const PageContext& with, QWidget* parent);

    void label();
    void show(const air::Shadow& shadow);
    [[nodiscard]] QString text() const;

private:
    PageContext m_with;
    CaptionBook m_book;
    SpectrumPlot* Air_Spektrum = nullptr;
    QLabel* Air_Spitzenhub = nullptr;
    Spectrum m_spectrum;
    std::uint64_t m_taken = 0;  ///< so many of what went out
};

}  // namespace kdx
