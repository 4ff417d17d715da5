#include "ui/application.h"

#include "ui/controls.h"
#include "ui/plaintext.h"

#include <QAbstractSpinBox>
#include <QComboBox>
#include <QEvent>
#include <QFont>
#include <QStyleFactory>

#include <cstdio>
#include <exception>
#include <utility>

namespace kdx {

namespace {

/// Runs the task; the text of an exception that leaves it goes to `failed`.
template <typename Task, typename Failed>
void guard(const Task& task, const Failed& failed) {
    try {
        task();
    } catch (const std::exception& error) {
        failed(QString::fromUtf8(error.what()));
    } catch (...) {
        failed(QStringLiteral("?"));
    }
}

QString nameOf(const QObject& object) {
    const QString name = object.objectName();
    return name.isEmpty() ? QString::fromLatin1(object.metaObject()->className()) : name;
}

}  // namespace

double letterSize(double desktop) {
    constexpr double kUsual = 9;  // what a desktop has that says nothing of it
    constexpr double kDesigned = 8.25;
    return desktop > kUsual ? desktop : kDesigned;
}

Application::Application(int& argc, char** argv) : QApplication(argc, argv) {
    setApplicationName(QStringLiteral("KDX-RDS"));
    setDesktopFileName(QStringLiteral("kdx-rds"));  // by which a desktop finds name and icon
    setApplicationVersion(QStringLiteral(KDX_VERSION));
    // One look on every desktop: the pages are laid out for it, and platform themes cost twice the start time.
    setStyle(QStyleFactory::create(QStringLiteral("Fusion")));
    QFont font = QApplication::font();
    font.setFamilies(arialFamilies());
    font.setPointSizeF(letterSize(font.pointSizeF()));
    setFont(font);
    installEventFilter(this);
}

// The wheel scrolls what a combo box or number field stands on: one notch too many must not change what is on the air.
bool Application::eventFilter(QObject* watched, QEvent* event) {
    if (event->type() != QEvent::Wheel) return false;
    if (qobject_cast<QComboBox*>(watched) == nullptr && qobject_cast<QAbstractSpinBox*>(watched) == nullptr)
        return false;
    event->ignore();
    return true;
}

void Application::onFailure(std::function<void(const QString&, const QString&)> report) {
    m_report = std::move(report);
}

bool Application::guarded(const QString& doing, const std::function<void()>& task) {
    bool whole = true;
    guard(task, [&](const QString& error) {
        whole = false;
        report(doing, error);
    });
    return whole;
}

void Application::end() {
    m_ending = true;
    closeAllWindows();
    exit(0);  // not quit(), which does nothing before the event loop runs: a box of the start would stay
}

bool Application::notify(QObject* receiver, QEvent* event) {
    if (event->type() == QEvent::Polish) keepTextPlain(*receiver);
    bool handled = true;
    guard([&] { handled = QApplication::notify(receiver, event); },
          [&](const QString& error) {
              if (event->type() == QEvent::Paint) {
                  reportPainting(nameOf(*receiver), error);
              } else {
                  report(nameOf(*receiver), error);
              }
          });
    return handled;
}

bool Application::event(QEvent* event) {
    if (event->type() == QEvent::Quit) m_ending = true;
    return QApplication::event(event);
}

void Application::report(const QString& doing, const QString& error) const {
    if (m_report) m_report(doing, error);
}

void Application::reportPainting(const QString& painted, const QString& error) {
    if (m_failedPaintings.contains(painted)) return;
    m_failedPaintings.insert(painted);
    std::fprintf(stderr, "kdx-rds: %s cannot be painted: %s\n", qUtf8Printable(painted), qUtf8Printable(error));
}

}  // namespace kdx
