#pragma once

#include "ui/automatics.h"
#include "ui/page.h"

#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>
#include <QRadioButton>

namespace kdx {

class RunLine;
class TmcBuilder;

/// Lower part of the TMC page: the list of messages and its transmission, one at a tick of `TMC_Sende_Timer`, each with
/// the announcement that tells receivers about TMC.
class TmcTransmission : public Page {
    Q_OBJECT
public:
    /// @param builder composes the message that is added to the list.
    TmcTransmission(const PageContext& with, const TmcBuilder& builder, QWidget* parent);

    void label() override;
    /// The first time fills the list with the messages that were kept.
    void load() override;

private:
    void create();
    void createSending();
    void arrange();

    void TMC_Gr8_apply_Click();
    void TMC_Gr8_Remove_Click();
    void TMC_Senden_Taste_Click();
    void TMC_Sende_Timer_Timer();
    void Stop_Timer_Click();
    void optMultiMessage_Click() { allowCycleTime(true); }
    void optSingleMessage_Click() { allowCycleTime(false); }

    void keepMessages();
    [[nodiscard]] bool setInterval();
    void allowChanges(bool allowed);
    void allowCycleTime(bool allowed);

    const TmcBuilder& m_builder;
    int m_sendPosition = 0;
    bool m_loaded = false;
    bool m_lossTold = false;  ///< that the list cannot be kept
    Automatic m_cycling;
    bool m_otherVariant = false;  ///< which announcement comes next

    QListWidget* TMC_List = nullptr;
    QPushButton *TMC_Gr8_apply = nullptr, *TMC_Gr8_Remove = nullptr;
    QRadioButton *optSingleMessage = nullptr, *optMultiMessage = nullptr;
    QLabel* lblCycleTime = nullptr;
    QLineEdit* txtCycleTime = nullptr;
    QPushButton *TMC_Senden_Taste = nullptr, *Stop_Timer = nullptr;
    Ticker* TMC_Sende_Timer = nullptr;
    RunLine* TMC_Lauf = nullptr;
};

}  // namespace kdx
