#pragma once

#include <QLabel>
#include <QListWidget>

#include <string_view>

#include "af/aflist.h"
#include "ui/caption.h"
#include "ui/controls.h"
#include "ui/valuestate.h"

class QBoxLayout;

namespace kdx {

/// Five AF lists of which one is shown: an option for each, and the tuned frequency and the alternative frequencies
/// of the chosen one under their headings. Every place gives the controls names and captions of its own.
class AfListView {
public:
    /// @param caption is followed by the list's number.
    void createOptions(const char* name, int caption, CaptionBook& book, QWidget* parent);
    /// Makes the part that follows the options. @param tuned shows the tuned frequency.
    void createContent(QLabel* tuned, const Caption& tunedHeading, const char* list, const Caption& listHeading,
                       CaptionBook& book);

    /// The options and the room that is left under them.
    [[nodiscard]] QBoxLayout* optionColumn() const;
    [[nodiscard]] QBoxLayout* contentColumn() const;

    /// Chooses the list of the number that is stored; one that no list has, such as 1.5, chooses none.
    void chooseStored(std::string_view number);
    /// Shows a list text; one without AFs leaves what was shown before.
    void show(std::string_view listText);
    /// Says of the list that is shown what is to be said.
    void mark(const Judgement& judgement);

    [[nodiscard]] OptionArray<kAfLists>& options() { return m_options; }
    [[nodiscard]] QListWidget* list() const { return m_list; }

private:
    OptionArray<kAfLists> m_options;
    QLabel* m_tunedHeading = nullptr;
    QLabel* m_tuned = nullptr;
    QLabel* m_listHeading = nullptr;
    QListWidget* m_list = nullptr;
};

}  // namespace kdx
