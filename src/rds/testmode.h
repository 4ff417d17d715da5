#pragma once

#include <QGroupBox>
#include <QPushButton>

#include "ui/page.h"

namespace kdx {

/// The frame `Frame11`: switches the coder between RDS operation and a fixed 8-bit test pattern. The caption of its
/// button is the only record of the mode; nothing is stored.
class TestMode : public Page {
    Q_OBJECT
public:
    TestMode(const PageContext& with, QWidget* parent);

    /// Selects the first pattern without sending it.
    void load() override { TestDat_Opt.choose(0); }
    void stepGoesOut(const Step& step) override;

private:
    void Taste_DATA_MODE_Click();
    void TestDat_Opt_Click(int index);

    void showMode(bool test);
    void enablePatterns(bool enabled);

    QGroupBox* Frame11 = nullptr;
    QPushButton* Taste_DATA_MODE = nullptr;  // its caption is the mode and no language changes it
    OptionArray<4> TestDat_Opt;
};

}  // namespace kdx
