#include "rds/testmode.h"

#include "coder/sendparam.h"
#include "rds/settings.h"
#include "ui/keymarks.h"
#include "ui/layouts.h"

namespace kdx {

namespace {

// The words are the mode itself and are compared, so they are the same in every language.
constexpr QStringView kStartCaption = u"RDS_Mode";
constexpr QStringView kRdsMode = u"&RDS_Mode";
constexpr QStringView kTestMode = u"&Test_Mode";

constexpr std::array kPatterns = {"0 0 0 0 0 0 0 0", "1 1 1 1 1 1 1 1", "0 1 0 1 0 1 0 1", "1 1 0 0 1 1 0 0"};

}  // namespace

TestMode::TestMode(const PageContext& with, QWidget* parent) : Page(with, parent) {
    Frame11 = captioned<QGroupBox>("Frame11", {420, "Test Mode"}, this);
    Taste_DATA_MODE = wired<QPushButton>("Taste_DATA_MODE", &QPushButton::clicked, &TestMode::Taste_DATA_MODE_Click,
                                         kStartCaption.toString(), Frame11);
    m_book.tip(Taste_DATA_MODE, {421, "Zwischen RDS-Betrieb und Testmuster umschalten"});
    TestDat_Opt.create("TestDat_Opt", Frame11);
    TestDat_Opt.onClick(this, &TestMode::TestDat_Opt_Click);
    m_with.marks.add(setting::kTestMode, Taste_DATA_MODE);
    m_with.marks.add(setting::kTestPattern, TestDat_Opt);
    for (std::size_t i = 0; i < kPatterns.size(); ++i) TestDat_Opt[i]->setText(QString::fromLatin1(kPatterns[i]));
    // The coder starts in RDS mode, where a pattern command would be read as a change of mode.
    enablePatterns(false);

    layOut(Frame11, grid({{{Taste_DATA_MODE, 2}}, {TestDat_Opt[0], TestDat_Opt[1]}, {TestDat_Opt[2], TestDat_Opt[3]}}));
    layOut(this, column({Frame11}), 0);
}

void TestMode::stepGoesOut(const Step& step) {
    if (step.key == setting::kTestMode) showMode(step.value == "1");
}

void TestMode::Taste_DATA_MODE_Click() {
    // The design caption has no ampersand, so the first click after the start selects RDS mode and not the test.
    const bool toTest = Taste_DATA_MODE->text() == kRdsMode;
    m_with.params.SendParam(setting::kTestMode, toTest ? "1" : "0");
    showMode(toTest);
}

void TestMode::TestDat_Opt_Click(int index) {
    m_with.params.SendParam(setting::kTestPattern, std::to_string(index + 1));
}

void TestMode::showMode(bool test) {
    Taste_DATA_MODE->setText((test ? kTestMode : kRdsMode).toString());
    enablePatterns(test);
}

void TestMode::enablePatterns(bool enabled) {
    for (QRadioButton* option : TestDat_Opt) option->setEnabled(enabled);
}

}  // namespace kdx
