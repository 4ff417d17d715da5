#pragma once

#include <QApplication>
#include <QTimer>
#include <QWidget>

#include <cstdio>
#include <fstream>
#include <string>

namespace kdx {

/// Runs the event loop until the window has painted, prints the process's peak memory in KiB and ends it.
inline int endAtFirstPaint(QWidget& window) {
    class Watch : public QObject {
        bool eventFilter(QObject* watched, QEvent* event) override {
            if (event->type() == QEvent::Paint) QTimer::singleShot(0, qApp, &QCoreApplication::quit);
            return QObject::eventFilter(watched, event);
        }
    } watch;
    window.installEventFilter(&watch);
    const int result = QApplication::exec();
    std::ifstream status("/proc/self/status");
    for (std::string line; std::getline(status, line);) {
        if (line.starts_with("VmHWM:")) std::puts(line.c_str());
    }
    std::fflush(stdout);
    _Exit(result);  // the end of the process is not what is measured
}

}  // namespace kdx
