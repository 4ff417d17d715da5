#pragma once

#include <QLineEdit>

#include <string>
#include <string_view>

#include "ui/sentvalue.h"

namespace kdx {

/// A text box that knows what of it the instrument has: a text that has not been sent yet, or that the coder does not
/// take, is marked.
class SentEntry : public QLineEdit {
    Q_OBJECT
public:
    /// @param key under which it is sent.
    SentEntry(const PageContext& with, const char* key, QWidget* parent);

    /// As SentValue has it.
    void goesOut(std::string_view value);
    void wentOut(std::string_view value);
    /// What went out has not arrived, or is meant for somebody else.
    void forget();
    /// Says the state anew: the language or a tip has changed.
    void refresh();
    /// What is to be said of a value of this key.
    [[nodiscard]] Judgement judge(std::string_view value) const { return judge(toShown(value)); }

protected:
    void paintEvent(QPaintEvent* event) override;

private:
    [[nodiscard]] static QString toShown(std::string_view value);
    [[nodiscard]] Judgement judge(const QString& entry) const;
    [[nodiscard]] std::string sentForm(std::string_view value) const;

    PageContext m_with;
    const char* m_key;
    SentValue m_sent;  ///< in the form in which it is sent
};

}  // namespace kdx
