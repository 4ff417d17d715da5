#pragma once

#include <QApplication>
#include <QSet>

#include <functional>

namespace kdx {

/// The program's letters in points: the designed ones, or larger where the desktop has them larger than usual.
[[nodiscard]] double letterSize(double desktop);

/// The application, with what holds for every control and every handler.
class Application : public QApplication {
public:
    Application(int& argc, char** argv);

    /// Who is told when a handler fails: the name of its control or timer, and the error's own text.
    void onFailure(std::function<void(const QString& doing, const QString& error)> report);
    /// Runs what no control or timer started, guarded like a handler. False when an exception left it.
    bool guarded(const QString& doing, const std::function<void()>& task);

    /// Ends the program: closes every window, also a box that waits for an answer.
    void end();
    /// Whether the program is ending, for whatever reason: there is nobody left to answer a box.
    [[nodiscard]] bool isEnding() const { return m_ending; }

    /// The one place where an exception that left a handler is caught. A failed painting is told on stderr, and once:
    /// a box over the window would only have it painted again.
    bool notify(QObject* receiver, QEvent* event) override;

protected:
    bool event(QEvent* event) override;
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    void report(const QString& doing, const QString& error) const;
    void reportPainting(const QString& painted, const QString& error);

    std::function<void(const QString&, const QString&)> m_report;
    QSet<QString> m_failedPaintings;
    bool m_ending = false;
};

}  // namespace kdx
