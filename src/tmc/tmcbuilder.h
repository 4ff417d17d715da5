#pragma once

#include "tmc/bitdisplay.h"
#include "tmc/searchcombo.h"
#include "tmc/valuelabel.h"
#include "ui/page.h"

#include <QCheckBox>
#include <QComboBox>
#include <QGroupBox>
#include <QPushButton>

namespace kdx {

class ShownList;

/// Upper part of the TMC page: composes one traffic message from its fields.
class TmcBuilder : public Page {
    Q_OBJECT
public:
    TmcBuilder(const PageContext& with, QWidget* parent);

    void label() override;
    /// Fills the extent and duration boxes and hides the bit display.
    void load() override;
    /// Reads the event and location lists anew; a chosen entry that is still there stays chosen.
    /// @throws std::runtime_error when one is missing; its box is then empty, the other one filled.
    void reloadLists();

    [[nodiscard]] QString locationText() const { return TMC_Loc_Combo->currentText(); }
    [[nodiscard]] QString eventText() const { return TMC_Event_Combo->currentText(); }
    [[nodiscard]] QString groupCode() const { return TMC_Gr8_Label->text(); }

private:
    void create();
    void createLists();
    void createDuration();
    void createCode();
    void arrange();

    void TMC_Event_Combo_Click() { showNumber(TMC_Event_Combo, TMC_Event_Hex_Label, BitDisplay::Event); }
    void TMC_Loc_Combo_Click() { showNumber(TMC_Loc_Combo, TMC_Local_Hex_Label, BitDisplay::Location); }
    void TMC_Var_Combo_Click();
    void Tmc_richtung_Click(int index) { m_bits->set(BitDisplay::U, index == 1 ? 1 : 0); }
    void TMC_Div_Click() { m_bits->set(BitDisplay::D, TMC_Div->isChecked() ? 1 : 0); }
    void TMC_F_Check_Click() { m_bits->set(BitDisplay::F, TMC_F_Check->isChecked() ? 1 : 0); }
    void TMC_T_Check_Click() { m_bits->set(BitDisplay::T, TMC_T_Check->isChecked() ? 1 : 0); }
    void TMC_DP1_Check_Click() { showDuration(); }
    void TMC_DP2_Check_Click() { showDuration(); }
    void TMC_DP3Check_Click() { showDuration(); }
    void DurationCombo_Click();
    void TMCInfoOnOff_Click();
    void TMCGruppe8Maker();

    void reload(QComboBox* combo, ShownList* list, const char* fileName);
    void showNumber(const QComboBox* combo, QLabel* hexadecimals, BitDisplay::Field field);
    void showDuration();

    QLabel *Label3 = nullptr, *Label4 = nullptr;  // headings of the events and the locations
    SearchCombo *TMC_Event_Combo = nullptr, *TMC_Loc_Combo = nullptr;
    ShownList *m_events = nullptr, *m_locations = nullptr;
    ValueLabel *TMC_Event_Hex_Label = nullptr, *TMC_Local_Hex_Label = nullptr;
    QGroupBox* TMC_Frame1 = nullptr;
    OptionArray<2> Tmc_richtung;
    QLabel* TMC_Var_Label = nullptr;
    QComboBox* TMC_Var_Combo = nullptr;
    QGroupBox* Frame5 = nullptr;
    QCheckBox *TMC_DP1_Check = nullptr, *TMC_DP2_Check = nullptr, *TMC_DP3Check = nullptr;
    QComboBox* DurationCombo = nullptr;
    QCheckBox *TMC_Div = nullptr, *TMC_F_Check = nullptr, *TMC_T_Check = nullptr;
    QPushButton* TMCInfoOnOff = nullptr;
    QLabel* m_bitsHeading = nullptr;
    BitDisplay* m_bits = nullptr;
    QLabel* m_codeHeading = nullptr;
    ValueLabel* TMC_Gr8_Label = nullptr;
};

}  // namespace kdx
