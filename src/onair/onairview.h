#pragma once

#include <QDialog>
#include <QPoint>

#include <optional>

#include "ui/caption.h"
#include "ui/pagecontext.h"

class QPushButton;
class QTimer;

namespace kdx {

class BudgetTable;
class GroupMonitor;
class RadioFace;
class RadioTables;
class SpectrumFrame;
struct Station;
namespace air {
class Shadow;
}

/// The view of what goes on the air: what a radio shows, the groups, the budgets and the spectrum, as the virtual coder
/// makes them of the commands. Stays open beside the main window.
class OnAirView : public QDialog {
    Q_OBJECT
public:
    /// @param station what was entered, kept true by the pages; outlives the view, as the shadow does.
    OnAirView(air::Shadow& shadow, const Station& station, const PageContext& with, QWidget* parent);

    void label();
    /// The lists of events and locations were changed.
    void forgetTexts();

protected:
    void showEvent(QShowEvent* event) override;
    void hideEvent(QHideEvent* event) override;

private:
    void AirTimer_Timer();
    void Air_Gruppen_Sichern_Click();
    void Air_MPX_Sichern_Click();
    void Air_Kopieren_Click();
    void arrange();

    air::Shadow& m_shadow;
    const Station& m_station;
    PageContext m_with;
    CaptionBook m_book;
    QTimer* m_timer = nullptr;
    std::optional<QPoint> m_place;  ///< where it was when it was last open
    RadioFace* m_face = nullptr;
    RadioTables* m_tables = nullptr;
    GroupMonitor* m_groups = nullptr;
    BudgetTable* m_budget = nullptr;
    SpectrumFrame* m_spectrum = nullptr;
    QPushButton* Air_Gruppen_Sichern = nullptr;
    QPushButton* Air_MPX_Sichern = nullptr;
    QPushButton* Air_Kopieren = nullptr;
    QPushButton* Air_Schliessen = nullptr;
};

}  // namespace kdx
