// The program's own window with settings loaded, up to its first paint; with --count, how many controls of each kind
// it has. Usage: program_window APP_FOLDER [--count]
#include <QAction>
#include <QCheckBox>
#include <QComboBox>
#include <QDoubleSpinBox>
#include <QGroupBox>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QMenu>
#include <QProgressBar>
#include <QPushButton>
#include <QRadioButton>
#include <QScrollArea>
#include <QScrollBar>

#include <cstdio>
#include <cstring>

#include "benchedprogram.h"
#include "firstpaint.h"
#include "link/lanvisa.h"
#include "ui/application.h"
#include "window/hmenue.h"

namespace {

template <typename Control>
int count(const QWidget& window) {
    int found = 0;
    for (const Control* control : window.findChildren<Control*>()) {
        if (!control->objectName().startsWith(QStringLiteral("qt_"))) ++found;
    }
    return found;
}

void printCounts(const QWidget& window) {
    std::printf(
        "QLabel=%d QPushButton=%d QRadioButton=%d QCheckBox=%d QComboBox=%d QLineEdit=%d QListWidget=%d "
        "QScrollBar=%d QGroupBox=%d QDoubleSpinBox=%d QProgressBar=%d QScrollArea=%d QMenu=%d QAction=%d\n",
        count<QLabel>(window), count<QPushButton>(window), count<QRadioButton>(window), count<QCheckBox>(window),
        count<QComboBox>(window), count<QLineEdit>(window), count<QListWidget>(window), count<QScrollBar>(window),
        count<QGroupBox>(window), count<QDoubleSpinBox>(window), count<QProgressBar>(window),
        count<QScrollArea>(window), count<QMenu>(window), count<QAction>(window));
}

}  // namespace

int main(int argc, char** argv) {
    if (argc < 2) return 2;
    kdx::Application application(argc, argv);
    kdx::LanVisa visa;
    kdx::BenchedProgram program(argv[1], visa);
    kdx::HMenue window(program.surroundings());
    window.startUp();
    if (argc > 2 && std::strcmp(argv[2], "--count") == 0) {
        printCounts(window);
        return 0;
    }
    window.show();
    return kdx::endAtFirstPaint(window);
}
