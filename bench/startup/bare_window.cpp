// The yardstick: a bare window with nine pages and as many controls of each kind as are named on the command line,
// the same style and font, nothing read and nothing wired. Ends at its first paint.
// Usage: bare_window QLabel=120 QPushButton=60 ...
#include <QCheckBox>
#include <QComboBox>
#include <QFont>
#include <QGridLayout>
#include <QGroupBox>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QMainWindow>
#include <QPushButton>
#include <QRadioButton>
#include <QScrollBar>
#include <QTabWidget>

#include <cstdio>
#include <map>
#include <string>

#include "firstpaint.h"
#include "ui/application.h"

namespace {

QWidget* make(const std::string& kind, QWidget* page) {
    const QString text = QStringLiteral("Caption");
    if (kind == "QPushButton") return new QPushButton(text, page);
    if (kind == "QRadioButton") return new QRadioButton(text, page);
    if (kind == "QCheckBox") return new QCheckBox(text, page);
    if (kind == "QLineEdit") return new QLineEdit(text, page);
    if (kind == "QScrollBar") return new QScrollBar(Qt::Horizontal, page);
    if (kind == "QListWidget") return new QListWidget(page);
    if (kind == "QGroupBox") return new QGroupBox(text, page);
    if (kind == "QComboBox") return new QComboBox(page);
    return new QLabel(text, page);
}

}  // namespace

int main(int argc, char** argv) {
    kdx::Application application(argc, argv);
    QMainWindow window;
    auto* tabs = new QTabWidget(&window);
    std::array<QGridLayout*, 9> pages{};
    for (std::size_t i = 0; i < pages.size(); ++i) {
        auto* page = new QWidget(tabs);
        pages[i] = new QGridLayout(page);
        tabs->addTab(page, QStringLiteral("Page %1").arg(i));
    }
    int made = 0;
    for (const QString& argument : QCoreApplication::arguments().mid(1)) {
        const auto parts = argument.split(QLatin1Char('='));
        for (int i = 0; i < parts.value(1).toInt(); ++i, ++made) {
            auto* page = pages[static_cast<std::size_t>(made) % pages.size()];
            page->addWidget(make(parts.value(0).toStdString(), page->parentWidget()), made / 9 / 8, made / 9 % 8);
        }
    }
    window.setCentralWidget(tabs);
    window.resize(640, 480);
    window.show();
    return kdx::endAtFirstPaint(window);
}
