#pragma once

#include <QLabel>

#include <string>

#include "ui/pagecontext.h"

namespace kdx {

/// The line that says what of the traffic messages is being sent, how often, since when and until when.
class RunLine : public QLabel {
    Q_OBJECT
public:
    RunLine(const PageContext& with, QWidget* parent);

    /// Says it anew in the current language.
    void label();
    /// Sending begins. @param milliseconds between two messages, 0 for never; @param once ends after one message.
    void begin(int milliseconds, bool once);
    /// A message went out. @param number counts from 1.
    void sent(const std::string& code, int number, int messages);
    /// Sending ends.
    void end();

private:
    [[nodiscard]] QString text() const;
    /// The code that is being sent; with a word when the coder does not take it.
    [[nodiscard]] QString shownCode() const;
    [[nodiscard]] QString seconds() const;

    PageContext m_with;
    bool m_running = false;
    bool m_once = false;
    int m_interval = 0;
    int m_count = 0;  ///< messages since the beginning
    int m_number = 0;
    int m_messages = 0;
    std::string m_code;
    std::string m_since, m_until;
};

}  // namespace kdx
