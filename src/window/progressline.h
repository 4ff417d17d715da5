#pragma once

#include <QString>
#include <QWidget>

class QLabel;
class QProgressBar;

namespace kdx {

/// The window's lower edge: a quiet line of text and, while a whole data set goes out, which command of how many is
/// being sent. Progress is painted at once, since no events are handled in between.
class ProgressLine : public QWidget {
    Q_OBJECT
public:
    explicit ProgressLine(QWidget* parent);

    /// What the line says while nothing is being sent.
    void setNotice(const QString& notice);

    /// Begins to count. @param pattern the text with %1 for the number of the command and %2 for how many there are.
    void begin(const QString& pattern, int total);
    /// One more command goes out.
    void step();
    /// More commands than foreseen (or fewer, when negative) are to go out.
    void addToTotal(int commands);
    /// Back to the notice.
    void end();

    [[nodiscard]] bool isCounting() const { return m_counting; }
    [[nodiscard]] int sent() const { return m_sent; }
    [[nodiscard]] int total() const { return m_total; }

private:
    void showCount();

    QLabel* m_text = nullptr;
    QProgressBar* m_bar = nullptr;
    QString m_notice;
    QString m_pattern;
    bool m_counting = false;
    int m_sent = 0;
    int m_total = 0;
};

/// Counts on the line while it lives; one within another leaves the counting to the outer one.
class CountedCommands {
public:
    CountedCommands(ProgressLine& line, const QString& pattern, int total)
        : m_line(line), m_outermost(!line.isCounting()) {
        if (m_outermost) m_line.begin(pattern, total);
    }
    ~CountedCommands() {
        if (m_outermost) m_line.end();
    }
    CountedCommands(const CountedCommands&) = delete;
    CountedCommands& operator=(const CountedCommands&) = delete;

private:
    ProgressLine& m_line;
    bool m_outermost;
};

}  // namespace kdx
