#pragma once

#include "ui/controls.h"
#include "ui/page.h"

#include <QCheckBox>
#include <QComboBox>
#include <QGroupBox>
#include <QLabel>
#include <QPushButton>

namespace kdx {

class BitDisplay;
class ValueLabel;

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
    [[nodiscard]] QString groupCode() const;

private:
    void create();
    void createLists();
    void createDuration();
    void createCode();
    void arrange();
    QLayout* arrangeLists();
    QLayout* arrangeFields();
    QLayout* arrangeCode();

    void TMC_Event_Combo_Click();
    void TMC_Loc_Combo_Click();
    void TMC_Var_Combo_Click();
    void Tmc_richtung_Click(int index);
    void TMC_Div_Click();
    void TMC_F_Check_Click();
    void TMC_T_Check_Click();
    void TMC_DP1_Check_Click();
    void TMC_DP2_Check_Click();
    void TMC_DP3Check_Click();
    void DurationCombo_Click();
    void TMCInfoOnOff_Click();
    void TMCGruppe8Maker();

    void fill(QComboBox* combo, const char* fileName);
    void showDuration();

    int m_dp1Weight = 0;  ///< 4 or 0
    int m_dp2Weight = 0;  ///< 2 or 0
    int m_dp3Weight = 0;  ///< 1 or 0

    QLabel *Label3 = nullptr, *Label4 = nullptr;  // headings of the events and the locations
    QComboBox *TMC_Event_Combo = nullptr, *TMC_Loc_Combo = nullptr;
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
    BitDisplay* m_bits = nullptr;
    QLabel* m_codeHeading = nullptr;
    ValueLabel* TMC_Gr8_Label = nullptr;
};

}  // namespace kdx
