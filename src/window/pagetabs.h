#pragma once

#include <QStackedWidget>
#include <QTabBar>
#include <QTabWidget>

namespace kdx {

/// The pages. At the font they were designed for it tells its layout no sizes of its own: the window's size is stated,
/// and asking all nine pages what they need takes a fifth of the whole start. That every page fits is the tests'
/// concern. With larger letters the pages are asked, and the tabs scroll where they must.
class PageTabs : public QTabWidget {
public:
    explicit PageTabs(QWidget* parent) : QTabWidget(parent) {
        // Given a size, the stack of pages is not asked for its own at its first showing.
        findChild<QStackedWidget*>()->resize(parent->size());
        tabBar()->setExpanding(true);
        askPages(false);
    }
    void askPages(bool asked) {
        m_asked = asked;
        tabBar()->setUsesScrollButtons(asked);
        updateGeometry();
    }
    [[nodiscard]] QSize sizeHint() const override { return minimumSizeHint(); }
    [[nodiscard]] QSize minimumSizeHint() const override { return m_asked ? QTabWidget::minimumSizeHint() : QSize(); }

private:
    bool m_asked = false;
};

}  // namespace kdx
