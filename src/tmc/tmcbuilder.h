#pragma once

#include "ui/controls.h"
#include "ui/pagecontext.h"

#include <QCheckBox>
#include <QComboBox>
#include <QGroupBox>
#include <QLabel>
#include <QPushButton>
#include <QWidget>

#include <array>

class QGridLayout;

namespace kdx {

/// Upper part of the TMC page: composes one traffic message from its fields. The labels of the bit display are the
/// only store of the message; a field that has not been touched yet holds "-".
class TmcBuilder : public QWidget {
    Q_OBJECT
public:
    TmcBuilder(const PageContext& with, QWidget* parent);

    /// Captions every control in the current language; the message stays.
    void label();
    /// Fills the extent and duration boxes and hides the bit display.
    void setUp();
    /// Reads the event and location lists anew; a chosen entry that is still there stays chosen.
    /// @throws std::runtime_error when one is missing; its box is then empty, the other one filled.
    void reloadLists();

    [[nodiscard]] QString locationText() const { return TMC_Loc_Combo->currentText(); }
    [[nodiscard]] QString eventText() const { return TMC_Event_Combo->currentText(); }
    [[nodiscard]] QString groupCode() const { return TMC_Gr8_Label->text(); }

private:
    static constexpr std::size_t kFields = 8;

    QLayout* placeLists();
    QLayout* placeFields();
    QLayout* placeFlags();
    QLayout* placeCode();
    QLabel* placeBits(const char* name, std::size_t field, int bits, QGridLayout* grid);
    void wire();

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

    PageContext m_with;
    int m_dp1Weight = 0;  ///< 4 or 0
    int m_dp2Weight = 0;  ///< 2 or 0
    int m_dp3Weight = 0;  ///< 1 or 0

    QLabel* Label3 = nullptr;  // heading of the events
    QLabel* Label4 = nullptr;  // heading of the locations
    QComboBox* TMC_Event_Combo = nullptr;
    QComboBox* TMC_Loc_Combo = nullptr;
    QLabel* TMC_Event_Hex_Label = nullptr;
    QLabel* TMC_Local_Hex_Label = nullptr;
    QGroupBox* TMC_Frame1 = nullptr;
    OptionArray<2> Tmc_richtung;
    QLabel* TMC_Var_Label = nullptr;
    QComboBox* TMC_Var_Combo = nullptr;
    QGroupBox* Frame5 = nullptr;
    QCheckBox* TMC_DP1_Check = nullptr;
    QCheckBox* TMC_DP2_Check = nullptr;
    QCheckBox* TMC_DP3Check = nullptr;
    QComboBox* DurationCombo = nullptr;
    QCheckBox* TMC_Div = nullptr;
    QCheckBox* TMC_T_Check = nullptr;
    QCheckBox* TMC_F_Check = nullptr;
    QPushButton* TMCInfoOnOff = nullptr;
    QLabel* TMCBL3_T = nullptr;
    QLabel* TMCBL3_F = nullptr;
    QLabel* TMCBL3_DP = nullptr;
    QLabel* TMCBL3_D = nullptr;
    QLabel* TMCBL3_U = nullptr;
    QLabel* TMCBL3_Extent = nullptr;
    QLabel* TMCBL3_Event = nullptr;
    QLabel* TMCBL3_Local = nullptr;
    QLabel* TMC_Gr8_Label = nullptr;
    QLabel* m_codeHeading = nullptr;
    std::array<QLabel*, kFields> m_bitHeadings{};
};

}  // namespace kdx
