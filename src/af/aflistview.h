#pragma once

#include <QLabel>

#include <string_view>

#include "af/aflist.h"
#include "ui/caption.h"
#include "ui/controls.h"

class QBoxLayout;
class QListWidget;

namespace kdx {

/// Five AF lists of which one is shown: an option for each, and the tuned frequency and the alternative frequencies
/// of the chosen one under their headings. Every place gives the controls names and captions of its own.
class AfListView {
public:
    /// @param caption is followed by the list's number.
    void createOptions(const char* name, int caption, CaptionBook& book, QWidget* parent);

    /// What shows a part of the list, and the heading above it.
    struct Part {
        const char* name;
        Caption heading;
    };
    /// Makes the part that follows the options. @tparam Tuned kind of label that shows the tuned frequency.
    template <typename Tuned = QLabel>
    Tuned* createContent(const Part& tuned, const Part& list, CaptionBook& book, QWidget* parent) {
        auto* label = named<Tuned>(tuned.name, parent);
        createContent(label, tuned.heading, list, book, parent);
        return label;
    }

    /// Adds the options and the room that is left under them.
    void arrangeOptions(QBoxLayout* column) const;
    void arrangeContent(QBoxLayout* column) const;

    /// Chooses the list of the number that is stored; one that no list has, such as 1.5, chooses none.
    void chooseStored(std::string_view number);
    /// Shows a list text; one without AFs leaves what was shown before.
    void show(std::string_view listText);

    [[nodiscard]] OptionArray<kAfLists>& options() { return m_options; }
    [[nodiscard]] QListWidget* list() const { return m_list; }

private:
    void createContent(QLabel* tuned, const Caption& heading, const Part& list, CaptionBook& book, QWidget* parent);

    OptionArray<kAfLists> m_options;
    QLabel* m_tunedHeading = nullptr;
    QLabel* m_tuned = nullptr;
    QLabel* m_listHeading = nullptr;
    QListWidget* m_list = nullptr;
};

}  // namespace kdx
