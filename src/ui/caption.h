#pragma once

#include <QString>

#include <string>
#include <type_traits>
#include <vector>

#include "ui/named.h"

class QLabel;
class QWidget;

namespace kdx {

class Captions;

/// A text of the window by its number. Numbers from 300 up are the program's own and have a design text (UTF-8,
/// German) for a language file without them; the others are as the file has them.
struct Caption {
    int number;
    const char* design = "";
    QString after = {};  ///< follows the text: " 3" in "Liste 3"
};

/// The text in the current language.
[[nodiscard]] QString captionText(const Captions& captions, const Caption& caption);
/// The same with the words, in UTF-8, in the places of %1 to %9.
[[nodiscard]] QString captionText(const Captions& captions, const Caption& caption,
                                  const std::vector<std::string>& words);

/// What a label or button shows, or the title of a frame.
[[nodiscard]] QString shownText(const QWidget* control);

/// The captions of a page's or window's controls: said once, where a control is made, and walked at every labelling.
class CaptionBook {
public:
    /// Makes a control that bears the system's name and is captioned from now on.
    template <typename Control>
    Control* captioned(const char* name, const Caption& caption, QWidget* parent) {
        auto* control = named<Control>(name, parent);
        text(control, caption);
        return control;
    }

    /// What the control shows: the text of a label or button, the title of a frame.
    void text(QWidget* control, const Caption& caption) { m_rows.push_back({control, What::Text, caption, nullptr}); }
    void tip(QWidget* control, const Caption& caption) { m_rows.push_back({control, What::Tip, caption, nullptr}); }
    /// What stands in an entry or a drop-down list where nothing is entered or chosen.
    void placeholder(QWidget* control, const Caption& caption) {
        m_rows.push_back({control, What::Placeholder, caption, nullptr});
    }
    /// Its name for who cannot see the window.
    void spoken(QWidget* control, const Caption& caption) {
        m_rows.push_back({control, What::Spoken, caption, nullptr});
    }
    /// Tool tip and spoken name in one.
    void describe(QWidget* control, const Caption& caption);
    /// Its spoken name is what the heading shows; for a button among like ones, followed by what it shows itself.
    void spokenAs(QWidget* control, const QWidget* heading) {
        m_rows.push_back({control, What::SpokenAs, {0}, heading});
    }

    /// The label is the control's heading: its spoken name, and by its mnemonic the way to it.
    void head(QLabel* heading, QWidget* control);

    /// Shows everything that was said, in that order, in the current language.
    void label(const Captions& captions) const;

private:
    enum class What { Text, Tip, Placeholder, Spoken, SpokenAs };
    struct Row {
        QWidget* control;
        What what;
        Caption caption;
        const QWidget* heading;
    };
    std::vector<Row> m_rows;
};

}  // namespace kdx
