#pragma once

#include <QApplication>

#include <functional>

namespace kdx {

/// The application with the one place where an exception that left a handler is caught.
class Application : public QApplication {
public:
    Application(int& argc, char** argv);

    /// Who is told: the name of the control or timer whose handler failed, and the error's own text.
    void onFailure(std::function<void(const QString& doing, const QString& error)> report);

    /// Ends the program: closes every window, also a box that waits for an answer.
    void end();
    /// Whether the program is ending, for whatever reason: there is nobody left to answer a box.
    [[nodiscard]] bool isEnding() const { return m_ending; }

    bool notify(QObject* receiver, QEvent* event) override;

protected:
    bool event(QEvent* event) override;

private:
    void report(const QObject* receiver, const QString& error);

    std::function<void(const QString&, const QString&)> m_report;
    bool m_ending = false;
};

}  // namespace kdx
