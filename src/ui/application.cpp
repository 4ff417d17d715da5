#include "ui/application.h"

#include "ui/controls.h"
#include "ui/plaintext.h"

#include <QEvent>
#include <QFont>
#include <QStyleFactory>

#include <exception>

namespace kdx {

Application::Application(int& argc, char** argv) : QApplication(argc, argv) {
    setApplicationName(QStringLiteral("KDX-RDS"));
    setApplicationVersion(QStringLiteral(KDX_VERSION));
    // One look on every desktop: the pages are laid out for it, and platform themes cost twice the start time.
    setStyle(QStyleFactory::create(QStringLiteral("Fusion")));
    QFont font = QApplication::font();
    font.setFamilies(arialFamilies());
    font.setPointSizeF(8.25);
    setFont(font);
}

void Application::onFailure(std::function<void(const QString&, const QString&)> report) {
    m_report = std::move(report);
}

void Application::end() {
    m_ending = true;
    closeAllWindows();
    exit(0);  // not quit(), which does nothing before the event loop runs: a box of the start would stay
}

bool Application::notify(QObject* receiver, QEvent* event) {
    if (event->type() == QEvent::Polish) keepTextPlain(*receiver);
    try {
        return QApplication::notify(receiver, event);
    } catch (const std::exception& error) {
        report(receiver, QString::fromUtf8(error.what()));
    } catch (...) {
        report(receiver, QStringLiteral("?"));
    }
    return true;
}

bool Application::event(QEvent* event) {
    if (event->type() == QEvent::Quit) m_ending = true;
    return QApplication::event(event);
}

void Application::report(const QObject* receiver, const QString& error) {
    if (m_report) m_report(receiver->objectName(), error);
}

}  // namespace kdx
