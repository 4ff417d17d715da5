#pragma once

#include <QGroupBox>

#include "ui/controls.h"
#include "ui/pagecontext.h"

class QPushButton;

namespace kdx {

/// The frame `Frame11`: switches the coder between RDS operation and a fixed 8-bit test pattern. The caption of its
/// button is the only record of the mode; nothing is stored.
class TestMode : public QGroupBox {
    Q_OBJECT
public:
    TestMode(const PageContext& with, QWidget* parent);

    /// Captions the frame in the current language. The button keeps its caption, which is its state.
    void label();
    /// Selects the first pattern without sending it.
    void selectFirstPattern();
    /// Returns the coder to RDS mode, whatever the mode is.
    void toRdsMode();

private:
    void Taste_DATA_MODE_Click();
    void TestDat_Opt_Click(int index);
    void enablePatterns(bool enabled);

    PageContext m_with;

    QPushButton* Taste_DATA_MODE = nullptr;
    OptionArray<4> TestDat_Opt;
};

}  // namespace kdx
