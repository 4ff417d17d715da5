// The yardstick: a bare window with nine pages and as many controls of each kind as are named on the command line, as
// many of them on the page in view as are named behind the stroke, in frames as controls are, the same style and font;
// nothing read and nothing wired. Ends at its first paint. Usage: bare_window QLabel=120/30 QPushButton=60/8 ...
#include <QCheckBox>
#include <QComboBox>
#include <QDoubleSpinBox>
#include <QFont>
#include <QGridLayout>
#include <QGroupBox>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QMainWindow>
#include <QMenu>
#include <QMenuBar>
#include <QProgressBar>
#include <QPushButton>
#include <QRadioButton>
#include <QScrollArea>
#include <QScrollBar>
#include <QTabWidget>

#include <algorithm>
#include <map>
#include <string>
#include <vector>

#include "firstpaint.h"
#include "ui/application.h"

namespace {

/// Of one kind.
struct Count {
    int all = 0;
    int inView = 0;
};
using Frames = std::vector<QGridLayout*>;

QWidget* make(const std::string& kind, int number, QWidget* page) {
    const QString text = QStringLiteral("Caption %1").arg(number);
    if (kind == "QPushButton") return new QPushButton(text, page);
    if (kind == "QRadioButton") return new QRadioButton(text, page);
    if (kind == "QCheckBox") return new QCheckBox(text, page);
    if (kind == "QLineEdit") return new QLineEdit(text, page);
    if (kind == "QScrollBar") return new QScrollBar(Qt::Horizontal, page);
    if (kind == "QListWidget") return new QListWidget(page);
    if (kind == "QComboBox") return new QComboBox(page);
    if (kind == "QDoubleSpinBox") return new QDoubleSpinBox(page);
    if (kind == "QProgressBar") return new QProgressBar(page);
    if (kind == "QScrollArea") return new QScrollArea(page);
    return new QLabel(text, page);
}

/// @param actions counts the one that each menu is opened by.
void addMenus(QMainWindow& window, int menus, int actions) {
    for (int i = 0; i < menus; ++i) window.menuBar()->addMenu(QStringLiteral("Menu %1").arg(i));
    const QList<QMenu*> made = window.menuBar()->findChildren<QMenu*>();
    for (int i = 0; i < actions - menus; ++i) {
        made[i % made.size()]->addAction(QStringLiteral("Action %1").arg(i));
    }
}

}  // namespace

int main(int argc, char** argv) {
    kdx::Application application(argc, argv);
    QMainWindow window;
    auto* tabs = new QTabWidget(&window);
    std::vector<QHBoxLayout*> pages;
    for (int i = 0; i < 9; ++i) {
        auto* page = new QWidget(tabs);
        pages.push_back(new QHBoxLayout(page));
        tabs->addTab(page, QStringLiteral("Page %1").arg(i));
    }
    std::map<QString, Count> counts;
    for (const QString& argument : QCoreApplication::arguments().mid(1)) {
        const auto parts = argument.split(QLatin1Char('='));
        const auto numbers = parts.value(1).split(QLatin1Char('/'));
        counts[parts.value(0)] = {numbers.value(0).toInt(), numbers.value(1).toInt()};
    }
    Frames inView;
    Frames hidden;
    const Count& groups = counts[QStringLiteral("QGroupBox")];
    for (int i = 0; i < std::max(groups.all, 9); ++i) {
        const bool seen = i < std::max(groups.inView, 1);
        QHBoxLayout* page = seen ? pages[0] : pages[1 + static_cast<std::size_t>(i) % (pages.size() - 1)];
        auto* frame = new QGroupBox(QStringLiteral("Frame %1").arg(i), page->parentWidget());
        page->addWidget(frame);
        (seen ? inView : hidden).push_back(new QGridLayout(frame));
    }
    int made = 0;
    for (const auto& [kind, count] : counts) {
        if (kind == QStringLiteral("QGroupBox") || kind == QStringLiteral("QMenu") || kind == QStringLiteral("QAction"))
            continue;
        for (int i = 0; i < count.all; ++i, ++made) {
            const Frames& frames = i < count.inView ? inView : hidden;
            QGridLayout* frame = frames[static_cast<std::size_t>(made) % frames.size()];
            frame->addWidget(make(kind.toStdString(), made, frame->parentWidget()), frame->count() / 2,
                             frame->count() % 2);
        }
    }
    addMenus(window, counts[QStringLiteral("QMenu")].all, counts[QStringLiteral("QAction")].all);
    window.setCentralWidget(tabs);
    window.resize(640, 480);
    window.show();
    return kdx::endAtFirstPaint(window);
}
