#pragma once

#include <QLabel>
#include <QStaticText>

namespace kdx {

/// A label for a text of any length whose parts are separated by commas without blanks: it breaks after a comma, where
/// a plain label would not break at all.
class SequenceLabel : public QLabel {
    Q_OBJECT
public:
    explicit SequenceLabel(QWidget* parent);

    [[nodiscard]] int heightForWidth(int width) const override;
    [[nodiscard]] QSize sizeHint() const override { return minimumSizeHint(); }
    [[nodiscard]] QSize minimumSizeHint() const override;

protected:
    void paintEvent(QPaintEvent* event) override;

private:
    [[nodiscard]] QStaticText laidOut(int width) const;
};

}  // namespace kdx
