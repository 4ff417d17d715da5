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
#include <type_traits>

#include "benchedprogram.h"
#include "firstpaint.h"
#include "link/lanvisa.h"
#include "ui/application.h"
#include "window/hmenue.h"

namespace {

/// Prints how many there are, and behind a stroke how many of them are seen at the start.
template <typename Control>
void print(const char* kind, const QWidget& window) {
    int found = 0;
    int seen = 0;
    for (const Control* control : window.findChildren<Control*>()) {
        if (control->objectName().startsWith(QStringLiteral("qt_"))) continue;
        ++found;
        if constexpr (std::is_base_of_v<QWidget, Control>) seen += control->isVisible() ? 1 : 0;
    }
    std::printf("%s=%d/%d ", kind, found, seen);
}

void printCounts(const QWidget& window) {
    print<QLabel>("QLabel", window);
    print<QPushButton>("QPushButton", window);
    print<QRadioButton>("QRadioButton", window);
    print<QCheckBox>("QCheckBox", window);
    print<QComboBox>("QComboBox", window);
    print<QLineEdit>("QLineEdit", window);
    print<QListWidget>("QListWidget", window);
    print<QScrollBar>("QScrollBar", window);
    print<QGroupBox>("QGroupBox", window);
    print<QDoubleSpinBox>("QDoubleSpinBox", window);
    print<QProgressBar>("QProgressBar", window);
    print<QScrollArea>("QScrollArea", window);
    print<QMenu>("QMenu", window);
    print<QAction>("QAction", window);
    std::printf("\n");
}

}  // namespace

int main(int argc, char** argv) {
    if (argc < 2) return 2;
    kdx::Application application(argc, argv);
    kdx::LanVisa visa;
    kdx::BenchedProgram program(argv[1], visa);
    kdx::HMenue window(program.surroundings());
    window.startUp();
    window.show();
    if (argc > 2 && std::strcmp(argv[2], "--count") == 0) {
        printCounts(window);
        return 0;
    }
    return kdx::endAtFirstPaint(window);
}
