#pragma once

#include <QLabel>

#include <functional>

class QTextLayout;

namespace kdx {

/// A label for a text of any length whose parts are separated by commas without blanks: it breaks after a comma, where
/// a plain label would not break at all. A part can be marked, and clicked.
class SequenceLabel : public QLabel {
    Q_OBJECT
public:
    explicit SequenceLabel(QWidget* parent);

    /// Marks so many characters of the text; none with 0.
    void mark(int from, int length);

    [[nodiscard]] int heightForWidth(int width) const override;
    [[nodiscard]] QSize sizeHint() const override { return minimumSizeHint(); }
    [[nodiscard]] QSize minimumSizeHint() const override;

signals:
    /// That character of the text was clicked.
    void clickedAt(int character);

protected:
    void paintEvent(QPaintEvent* event) override;
    void mousePressEvent(QMouseEvent* event) override;

private:
    void withLayout(int width, const std::function<void(QTextLayout& layout, qreal height)>& look) const;

    int m_markedFrom = 0;
    int m_marked = 0;
};

}  // namespace kdx
