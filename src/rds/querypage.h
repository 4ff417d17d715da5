#pragma once

#include <QPushButton>

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

private:
    void create();
    void arrange();

    /// What every button does: ask its questions in turn and show the answers; nothing while no session is open.
    void ask(const ReadBack& readBack);
    void showAnswers();

    std::vector<QPushButton*> m_buttons;  // `Command1`, `Command4` to `Command22`, in that order
    QLabel* gelesen = nullptr;            // the read-back label
    const ReadBack* m_asked = nullptr;    ///< whose answers are shown; none at first
    std::vector<std::string> m_answers;
};

}  // namespace kdx
