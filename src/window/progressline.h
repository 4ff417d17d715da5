#pragma once

#include <QString>
#include <QWidget>

#include <cstddef>

class QLabel;
class QProgressBar;
class QPushButton;

namespace kdx {

/// The window's lower edge: a quiet line of text and, while a sequence goes out, which command of how many is being
/// sent. Progress is painted at once, since events may be handled late. Beside it stand the buttons that end what runs,
/// while it does.
class ProgressLine : public QWidget {
    Q_OBJECT
public:
    explicit ProgressLine(QWidget* parent);

    /// What the line says while nothing is being sent.
    void setNotice(const QString& notice);
    /// Says what is waited for before the first command.
    void showWait(const QString& text);
    /// Says that command `number` of `total` goes out. @param pattern the text, with %1 and %2 for the two.
    void showProgress(const QString& pattern, std::size_t number, std::size_t total);
    /// Back to the notice.
    void endProgress();
    [[nodiscard]] QPushButton* stop() const { return Stop_Taste; }
    [[nodiscard]] QPushButton* panic() const { return Panik_Taste; }

private:
    QPushButton* addButton(const char* name);

    QPushButton* Stop_Taste = nullptr;   // of the run that goes out
    QPushButton* Panik_Taste = nullptr;  // of all that sends by itself
    QLabel* m_text = nullptr;
    QProgressBar* m_bar = nullptr;
    QString m_notice;
    bool m_counting = false;
};

}  // namespace kdx
