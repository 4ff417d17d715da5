#pragma once

#include <QLabel>

namespace kdx {

/// The display of a radio for the programme's name: a cell for each of its eight characters.
class NameDisplay final : public QLabel {
public:
    explicit NameDisplay(QWidget* parent);
    [[nodiscard]] QSize sizeHint() const override;
    [[nodiscard]] QSize minimumSizeHint() const override { return sizeHint(); }

protected:
    void paintEvent(QPaintEvent* event) override;

private:
    [[nodiscard]] QSize cellSize() const;
};

/// The display of a radio for the radiotext, two lines that are broken anywhere when a word is too long.
class TextDisplay final : public QLabel {
public:
    explicit TextDisplay(QWidget* parent);
    [[nodiscard]] QSize sizeHint() const override;
    [[nodiscard]] int heightForWidth(int /*width*/) const override { return sizeHint().height(); }
    [[nodiscard]] QSize minimumSizeHint() const override { return sizeHint(); }

protected:
    void paintEvent(QPaintEvent* event) override;
};

}  // namespace kdx
