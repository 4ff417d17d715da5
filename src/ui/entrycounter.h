#pragma once

#include <QLabel>

#include "ui/pagecontext.h"

class QLineEdit;

namespace kdx {

/// Counts the characters of a text box as they are typed, and warns when the coder would not take them.
class EntryCounter : public QLabel {
    Q_OBJECT
public:
    /// @param key under which the text is sent; @param most characters that it may have.
    EntryCounter(const PageContext& with, const char* key, std::size_t most, const QLineEdit* entry, QWidget* parent);

    /// Counts anew, in the current language.
    void count();

private:
    PageContext m_with;
    const char* m_key;
    std::size_t m_most;
    const QLineEdit* m_entry;
};

}  // namespace kdx
