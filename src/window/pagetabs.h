#pragma once

#include <QStackedWidget>
#include <QTabWidget>

namespace kdx {

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

}  // namespace kdx
