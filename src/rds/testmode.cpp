#include "rds/testmode.h"

#include <QGridLayout>
#include <QPushButton>

#include "coder/sendparam.h"
#include "settings/captions.h"
#include "ui/named.h"
#include "ui/text.h"

namespace kdx {

namespace {

// The words are the mode itself and are compared, so they are the same in every language.
constexpr QStringView kStartCaption = u"RDS_Mode";
constexpr QStringView kRdsMode = u"&RDS_Mode";
constexpr QStringView kTestMode = u"&Test_Mode";

constexpr std::array kPatterns = {"0 0 0 0 0 0 0 0", "1 1 1 1 1 1 1 1", "0 1 0 1 0 1 0 1", "1 1 0 0 1 1 0 0"};

}  // namespace

TestMode::TestMode(const PageContext& with, QWidget* parent) : QGroupBox(parent), m_with(with) {
    setObjectName(QStringLiteral("Frame11"));
    auto* grid = new QGridLayout(this);
    tighten(grid);
    Taste_DATA_MODE = named<QPushButton>("Taste_DATA_MODE", kStartCaption.toString(), this);
    connect(Taste_DATA_MODE, &QPushButton::clicked, this, &TestMode::Taste_DATA_MODE_Click);
    grid->addWidget(Taste_DATA_MODE, 0, 0, 1, 2);
    TestDat_Opt.create("TestDat_Opt", this);
    for (std::size_t i = 0; i < kPatterns.size(); ++i) {
        TestDat_Opt[i]->setText(QString::fromLatin1(kPatterns[i]));
        connect(TestDat_Opt[i], &QRadioButton::clicked, this, [this, i] { TestDat_Opt_Click(static_cast<int>(i)); });
        grid->addWidget(TestDat_Opt[i], 1 + static_cast<int>(i) / 2, static_cast<int>(i) % 2);
    }
    // The coder starts in RDS mode, where a pattern command would be read as a change of mode.
    enablePatterns(false);
    label();
}

void TestMode::label() {
    setTitle(toText(m_with.captions.own(420, "Test Mode")));
    Taste_DATA_MODE->setToolTip(toText(m_with.captions.own(421, "Zwischen RDS-Betrieb und Testmuster umschalten")));
}

void TestMode::selectFirstPattern() {
    TestDat_Opt.choose(0);
}

void TestMode::toRdsMode() {
    Taste_DATA_MODE->setText(QString());
    Taste_DATA_MODE_Click();
}

void TestMode::Taste_DATA_MODE_Click() {
    // The design caption has no ampersand, so the first click after the start selects RDS mode and not the test.
    const bool toTest = Taste_DATA_MODE->text() == kRdsMode;
    m_with.params.SendParam("TEST_M", toTest ? "1" : "0");
    Taste_DATA_MODE->setText((toTest ? kTestMode : kRdsMode).toString());
    enablePatterns(toTest);
}

void TestMode::TestDat_Opt_Click(int index) {
    m_with.params.SendParam("TEST_D", std::to_string(index + 1));
}

void TestMode::enablePatterns(bool enabled) {
    for (QRadioButton* option : TestDat_Opt) option->setEnabled(enabled);
}

}  // namespace kdx
