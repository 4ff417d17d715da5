// How the page "FM / Stereo" is made: its controls, where they stand, which handler each one has, what they are called.
#include "stereo/stereopage.h"

#include <QGridLayout>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QPushButton>
#include <QVBoxLayout>

#include <array>
#include <initializer_list>

#include "settings/captions.h"
#include "ui/named.h"
#include "ui/pictureswitch.h"
#include "ui/text.h"

namespace kdx {

namespace {

constexpr int kLowestPilotPhase = -4;
constexpr int kHighestPilotPhase = 5;
constexpr int kFirstPilotPhase = 2;
constexpr int kHighestRdsPhase = 359;

// Caption numbers.
constexpr int kSourceCaptions = 22;  // and the three after it
constexpr int kOffWord = 193;

/// Texts of this page that have numbers of the program's own; 8-bit, German.
struct OwnText {
    int number;
    const char* design;
};
constexpr OwnText kFmTitle{341, "FM"};
constexpr OwnText kRdsTitle{342, "R D S"};
constexpr OwnText kAriTitle{343, "A R I"};
constexpr OwnText kPilot{344, "Pilotton"};
constexpr OwnText kArea{345, "Bereich"};
constexpr OwnText kSendAll{346, "&Alles senden"};
constexpr OwnText kSendAllTip{347, "Den ganzen Datensatz an das Ger\xE4t senden"};
constexpr OwnText kTotalName{348, "Gesamthub"};
constexpr OwnText kPilotName{349, "Pilottonhub"};
constexpr OwnText kPilotPhaseName{350, "Pilottonphase"};
constexpr OwnText kRdsName{351, "RDS-Hub"};
constexpr OwnText kRdsPhaseName{352, "RDS-Phase"};
constexpr OwnText kAriName{353, "ARI-Hub"};
constexpr OwnText kPilotSwitch{354, "Pilotton ein / aus"};
constexpr OwnText kRdsSwitch{355, "RDS-Tr\xE4ger ein / aus"};
constexpr OwnText kAriSwitch{356, "ARI ein / aus"};
constexpr std::array kImpedances = {OwnText{357, "600 Ohm"}, OwnText{358, "100k Ohm"}};
constexpr std::array kPreemphases = {OwnText{359, "50 \xB5s"}, OwnText{360, "75 \xB5s"}};
constexpr std::array kStereoModes = {OwnText{361, "links"}, OwnText{362, "rechts"}, OwnText{363, "links = rechts"},
                                     OwnText{364, "links = -rechts"}, OwnText{365, "links =/ rechts"}};
constexpr std::array kAriModes = {OwnText{366, "DK"}, OwnText{367, "BK"}, OwnText{368, "DK + BK"}};
constexpr std::array kAreas = {OwnText{369, "A"}, OwnText{370, "B"}, OwnText{371, "C"},
                               OwnText{372, "D"}, OwnText{373, "E"}, OwnText{374, "F"}};

/// A frame whose layout takes a stack of options.
QGroupBox* optionFrame(const char* name, QWidget* parent) {
    auto* frame = named<QGroupBox>(name, parent);
    tighten(new QVBoxLayout(frame));
    return frame;
}

/// Puts options under each other into their frame; room to spare goes below them.
template <std::size_t Count>
void stack(const OptionArray<Count>& options, QWidget* frame) {
    auto* rows = static_cast<QVBoxLayout*>(frame->layout());
    for (QRadioButton* option : options) rows->addWidget(option);
    rows->addStretch(1);
}

/// Runs a handler with the option's index at every click on one.
template <std::size_t Count>
void connectOptions(const OptionArray<Count>& options, StereoPage* page, void (StereoPage::*click)(int index)) {
    for (std::size_t i = 0; i < Count; ++i) {
        QObject::connect(options[i], &QRadioButton::clicked, page,
                         [page, click, i] { (page->*click)(static_cast<int>(i)); });
    }
}

/// Puts a row of controls into a line of its own.
QHBoxLayout* line(std::initializer_list<QWidget*> controls) {
    auto* row = new QHBoxLayout;
    tighten(row, 0);
    for (QWidget* control : controls) row->addWidget(control, qobject_cast<QLabel*>(control) != nullptr ? 1 : 0);
    return row;
}

}  // namespace

StereoPage::StereoPage(const PageContext& with, QWidget* testMode, QWidget* parent) : QWidget(parent), m_with(with) {
    auto* columns = new QGridLayout(this);
    tighten(columns, kPageMargin);
    columns->setHorizontalSpacing(2 * kGap);
    auto* left = new QVBoxLayout;
    auto* middle = new QVBoxLayout;
    auto* right = new QVBoxLayout;
    int column = 0;
    for (QVBoxLayout* layout : {left, middle, right}) {
        tighten(layout, 0);
        columns->addLayout(layout, 0, column);
        columns->setColumnStretch(column, 1);
        ++column;
    }
    // Room to spare goes below the frames: their controls stay together.
    columns->setRowStretch(1, 1);
    left->addWidget(makeFmFrame(), 1);
    middle->addWidget(makeStereoFrame(), 1);
    middle->addWidget(makeRdsFrame());
    right->addWidget(makeAriFrame());
    testMode->setParent(this);
    right->addWidget(testMode);
    Btn_SetRdsStereo = named<QPushButton>("Btn_SetRdsStereo", this);
    connect(Btn_SetRdsStereo, &QPushButton::clicked, this, &StereoPage::setRdsStereoRequested);
    right->addStretch(1);
    right->addWidget(Btn_SetRdsStereo);
    label();
}

QWidget* StereoPage::makeFmFrame() {
    FM_Frame = named<QGroupBox>("FM_Frame", this);
    FM_Hub_Label2 = named<QLabel>("FM_Hub_Label2", FM_Frame);
    FM_Hub_Scroll = named<SettingScrollBar>("FM_Hub_Scroll", FM_Frame);
    makeDeviation(kTotalDeviation, FM_Hub_Scroll, FM_Hub_Label2);
    connect(FM_Hub_Scroll, &QScrollBar::valueChanged, this, &StereoPage::FM_Hub_Scroll_Change);

    FM_Sorce_Frame = optionFrame("FM_Sorce_Frame", FM_Frame);
    FM_Source_Opt.create("FM_Source_Opt", FM_Sorce_Frame);
    stack(FM_Source_Opt, FM_Sorce_Frame);
    FM_Imp_Frame = optionFrame("FM_Imp_Frame", FM_Frame);
    FM_Imp_Opt.create("FM_Imp_Opt", FM_Imp_Frame);
    stack(FM_Imp_Opt, FM_Imp_Frame);
    Pre_Frame = optionFrame("Pre_Frame", FM_Frame);
    Pre_opt.create("Pre_opt", Pre_Frame);
    stack(Pre_opt, Pre_Frame);
    connectOptions(FM_Source_Opt, this, &StereoPage::FM_Source_Opt_Click);
    connectOptions(FM_Imp_Opt, this, &StereoPage::FM_Imp_Opt_Click);
    connectOptions(Pre_opt, this, &StereoPage::Pre_opt_Click);

    auto* grid = new QGridLayout(FM_Frame);
    tighten(grid);
    grid->addWidget(FM_Hub_Label2, 0, 0, 1, 2);
    grid->addWidget(FM_Hub_Scroll, 1, 0, 1, 2);
    grid->addWidget(FM_Sorce_Frame, 2, 0, 1, 2);
    grid->addWidget(FM_Imp_Frame, 3, 0);
    grid->addWidget(Pre_Frame, 3, 1);
    grid->setRowStretch(4, 1);
    return FM_Frame;
}

QWidget* StereoPage::makeStereoFrame() {
    Frame_stereo = named<QGroupBox>("Frame_stereo", this);
    Stereo_Opt.create("Stereo_Opt", Frame_stereo);
    connectOptions(Stereo_Opt, this, &StereoPage::Stereo_Opt_Click);
    m_pilotHeading = new QLabel(Frame_stereo);
    Pilot_OnOff = named<PictureSwitch>("Pilot_OnOff", m_with.data, Frame_stereo);
    connect(Pilot_OnOff, &PictureSwitch::clicked, this, &StereoPage::Pilot_OnOff_Click);
    Pilot_hub_Label = named<QLabel>("Pilot_hub_Label", Frame_stereo);
    Pilot_Hub_Scroll = named<SettingScrollBar>("Pilot_Hub_Scroll", Frame_stereo);
    makeDeviation(kPilotDeviation, Pilot_Hub_Scroll, Pilot_hub_Label);
    connect(Pilot_Hub_Scroll, &QScrollBar::valueChanged, this, &StereoPage::Pilot_Hub_Scroll_Change);
    HScroll1_Label = named<QLabel>("HScroll1_Label", Frame_stereo);
    HScroll1 = named<SettingScrollBar>("HScroll1", Frame_stereo);
    HScroll1->setScale(kLowestPilotPhase, kHighestPilotPhase, 1);
    HScroll1->setValue(kFirstPilotPhase);
    connect(HScroll1, &QScrollBar::sliderMoved, this, &StereoPage::showPilotPhase);
    connect(HScroll1, &QScrollBar::valueChanged, this, &StereoPage::HScroll1_Change);

    auto* rows = new QVBoxLayout(Frame_stereo);
    tighten(rows);
    stack(Stereo_Opt, Frame_stereo);
    rows->addLayout(line({m_pilotHeading, Pilot_OnOff}));
    rows->addWidget(Pilot_hub_Label);
    rows->addWidget(Pilot_Hub_Scroll);
    rows->addWidget(HScroll1_Label);
    rows->addWidget(HScroll1);
    return Frame_stereo;
}

QWidget* StereoPage::makeRdsFrame() {
    RDS_Frame = named<QGroupBox>("RDS_Frame", this);
    RDS_Hub_Label = named<QLabel>("RDS_Hub_Label", RDS_Frame);
    RDS_OnOff = named<PictureSwitch>("RDS_OnOff", m_with.data, RDS_Frame);
    connect(RDS_OnOff, &PictureSwitch::clicked, this, &StereoPage::RDS_OnOff_Click);
    RDS_Hub_Scroll = named<SettingScrollBar>("RDS_Hub_Scroll", RDS_Frame);
    makeDeviation(kRdsDeviation, RDS_Hub_Scroll, RDS_Hub_Label);
    connect(RDS_Hub_Scroll, &QScrollBar::valueChanged, this, &StereoPage::RDS_Hub_Scroll_Change);
    // No command sets the RDS phase: the control has its range and no handler, and start-up hides it.
    RDS_Phase_Label = named<QLabel>("RDS_Phase_Label", RDS_Frame);
    RDS_Phase_Scroll = named<SettingScrollBar>("RDS_Phase_Scroll", RDS_Frame);
    RDS_Phase_Scroll->setScale(0, kHighestRdsPhase, 1);

    auto* rows = new QVBoxLayout(RDS_Frame);
    tighten(rows);
    rows->addLayout(line({RDS_Hub_Label, RDS_OnOff}));
    rows->addWidget(RDS_Hub_Scroll);
    rows->addWidget(RDS_Phase_Label);
    rows->addWidget(RDS_Phase_Scroll);
    return RDS_Frame;
}

QWidget* StereoPage::makeAriFrame() {
    Ari_Frame = named<QGroupBox>("Ari_Frame", this);
    Ari_Label = named<QLabel>("Ari_Label", Ari_Frame);
    Ari_OnOff = named<PictureSwitch>("Ari_OnOff", m_with.data, Ari_Frame);
    connect(Ari_OnOff, &PictureSwitch::clicked, this, &StereoPage::Ari_OnOff_Click);
    Ari_hub_Scroll = named<SettingScrollBar>("Ari_hub_Scroll", Ari_Frame);
    makeDeviation(kAriDeviation, Ari_hub_Scroll, Ari_Label);
    connect(Ari_hub_Scroll, &QScrollBar::valueChanged, this, &StereoPage::Ari_hub_Scroll_Change);
    ARI_Mode_Opt.create("ARI_Mode_Opt", Ari_Frame);
    connectOptions(ARI_Mode_Opt, this, &StereoPage::ARI_Mode_Opt_Click);
    m_areaHeading = new QLabel(Ari_Frame);
    BK_Opt.create("BK_Opt", Ari_Frame);
    connectOptions(BK_Opt, this, &StereoPage::BK_Opt_Click);

    auto* grid = new QGridLayout(Ari_Frame);
    tighten(grid);
    // Six columns: the modes take three each, the areas two.
    constexpr int kColumns = 6;
    grid->addLayout(line({Ari_Label, Ari_OnOff}), 0, 0, 1, kColumns);
    grid->addWidget(Ari_hub_Scroll, 1, 0, 1, kColumns);
    for (int i = 0; i < 4; ++i) {
        grid->addWidget(ARI_Mode_Opt[static_cast<std::size_t>(i)], 2 + i / 2, 3 * (i % 2), 1, 3);
    }
    grid->addWidget(m_areaHeading, 4, 0, 1, kColumns);
    for (int i = 0; i < kColumns; ++i) {
        grid->addWidget(BK_Opt[static_cast<std::size_t>(i)], 5 + i / 3, 2 * (i % 3), 1, 2);
        grid->setColumnStretch(i, 1);
    }
    return Ari_Frame;
}

void StereoPage::makeDeviation(const Deviation& deviation, SettingScrollBar* scroll, QLabel* value) {
    scroll->setScale(0, deviation.highest, deviation.step);
    connect(scroll, &QScrollBar::sliderMoved, this,
            [this, &deviation, value](int tensOfHertz) { showDeviation(deviation, tensOfHertz, value); });
}

void StereoPage::label() {
    const Captions& captions = m_with.captions;
    const auto numbered = [&captions](int number) { return toText(captions.text(number)); };
    const auto own = [&captions](const OwnText& text) { return toText(captions.own(text.number, text.design)); };
    const auto describe = [&own](QWidget* control, const OwnText& text) {
        control->setAccessibleName(own(text));
        control->setToolTip(own(text));
    };

    FM_Sorce_Frame->setTitle(numbered(20));
    for (std::size_t i = 0; i < FM_Source_Opt.size(); ++i) {
        FM_Source_Opt[i]->setText(numbered(kSourceCaptions + static_cast<int>(i)));
    }
    FM_Imp_Frame->setTitle(numbered(26));
    Pre_Frame->setTitle(numbered(27));
    Pre_opt[0]->setText(numbered(28));
    Frame_stereo->setTitle(numbered(29));
    ARI_Mode_Opt[0]->setText(numbered(kOffWord));

    FM_Frame->setTitle(own(kFmTitle));
    RDS_Frame->setTitle(own(kRdsTitle));
    Ari_Frame->setTitle(own(kAriTitle));
    for (std::size_t i = 0; i < kImpedances.size(); ++i) FM_Imp_Opt[i]->setText(own(kImpedances[i]));
    for (std::size_t i = 0; i < kPreemphases.size(); ++i) Pre_opt[i + 1]->setText(own(kPreemphases[i]));
    for (std::size_t i = 0; i < kStereoModes.size(); ++i) Stereo_Opt[i]->setText(own(kStereoModes[i]));
    for (std::size_t i = 0; i < kAriModes.size(); ++i) ARI_Mode_Opt[i + 1]->setText(own(kAriModes[i]));
    for (std::size_t i = 0; i < kAreas.size(); ++i) BK_Opt[i]->setText(own(kAreas[i]));
    m_pilotHeading->setText(own(kPilot));
    m_areaHeading->setText(own(kArea));
    Btn_SetRdsStereo->setText(own(kSendAll));
    Btn_SetRdsStereo->setToolTip(own(kSendAllTip));
    describe(FM_Hub_Scroll, kTotalName);
    describe(Pilot_Hub_Scroll, kPilotName);
    describe(HScroll1, kPilotPhaseName);
    describe(RDS_Hub_Scroll, kRdsName);
    describe(RDS_Phase_Scroll, kRdsPhaseName);
    describe(Ari_hub_Scroll, kAriName);
    describe(Pilot_OnOff, kPilotSwitch);
    describe(RDS_OnOff, kRdsSwitch);
    describe(Ari_OnOff, kAriSwitch);
    showValues();
}

}  // namespace kdx
