#pragma once

#include <QPushButton>
#include <QScrollArea>

#include <string>
#include <vector>

#include "ui/page.h"

namespace kdx {

struct ReadBack;

/// The page "Fragen": one button per parameter group asks the instrument; the answer is shown in words in `gelesen`.
class QueryPage : public Page {
    Q_OBJECT
public:
    QueryPage(const PageContext& with, QWidget* parent);

    /// The last answers are shown in the words of the new language.
    void label() override;

    /// Switches the read-back buttons on or off.
    void Fragen_Schalter(bool on);
    /// What all buttons do, one after the other; shows all answers.
    void askAll();

private:
    void create();
    void arrange();

    struct Answered {
        const ReadBack* asked;
        std::vector<std::string> answers;
    };

    /// What every button does: ask its questions in turn and show the answers; nothing while no session is open.
    void ask(const std::vector<const ReadBack*>& readBacks);
    void showAnswers();

    std::vector<QPushButton*> m_buttons;  // `Command1`, `Command4` to `Command22`, in that order
    QScrollArea* m_shown = nullptr;       ///< around the label: all answers together are long
    QLabel* gelesen = nullptr;            // the read-back label
    std::vector<Answered> m_answers;      ///< what is shown; nothing at first
};

}  // namespace kdx
