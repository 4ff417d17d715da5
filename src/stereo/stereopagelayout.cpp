// How the page "FM / Stereo" is made: its controls, what they are called, which handler each one has, where they stand.
#include "stereo/stereopage.h"

#include <QGridLayout>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QPushButton>
#include <QVBoxLayout>

#include <initializer_list>

#include "settings/storedvalue.h"
#include "ui/pictureswitch.h"

namespace kdx {

namespace {

constexpr int kHighestRdsPhase = 359;

/// Puts options under each other into their frame; room to spare goes below them.
template <std::size_t Count>
QVBoxLayout* stack(const OptionArray<Count>& options, QWidget* frame) {
    auto* rows = new QVBoxLayout(frame);
    tighten(rows);
    for (QRadioButton* option : options) rows->addWidget(option);
    rows->addStretch(1);
    return rows;
}

/// Puts a heading and its control into a line of their own.
QHBoxLayout* line(QLabel* heading, QWidget* control) {
    auto* row = new QHBoxLayout;
    tighten(row, 0);
    row->addWidget(heading, 1);
    row->addWidget(control);
    return row;
}

}  // namespace

void StereoPage::create() {
    createFm();
    createStereo();
    createSubcarriers();
    m_testMode->setParent(this);
    Btn_SetRdsStereo = captioned<QPushButton>("Btn_SetRdsStereo", {346, "&Alles senden"}, this);
    m_book.tip(Btn_SetRdsStereo, {347, "Den ganzen Datensatz an das Gerät senden"});
    connect(Btn_SetRdsStereo, &QPushButton::clicked, this, &StereoPage::setRdsStereoRequested);
}

void StereoPage::createFm() {
    FM_Frame = captioned<QGroupBox>("FM_Frame", {341, "FM"}, this);
    createDeviation(FM_Hub_Scroll, "FM_Hub_Scroll", "FM_Hub_Label2", {348, "Gesamthub"},
                    &StereoPage::FM_Hub_Scroll_Change, FM_Frame);
    FM_Sorce_Frame = captioned<QGroupBox>("FM_Sorce_Frame", {20}, FM_Frame);
    createOptions(FM_Source_Opt, "FM_Source_Opt", &StereoPage::FM_Source_Opt_Click, {{22}, {23}, {24}, {25}},
                  FM_Sorce_Frame);
    FM_Imp_Frame = captioned<QGroupBox>("FM_Imp_Frame", {26}, FM_Frame);
    createOptions(FM_Imp_Opt, "FM_Imp_Opt", &StereoPage::FM_Imp_Opt_Click, {{357, "600 Ohm"}, {358, "100k Ohm"}},
                  FM_Imp_Frame);
    Pre_Frame = captioned<QGroupBox>("Pre_Frame", {27}, FM_Frame);
    createOptions(Pre_opt, "Pre_opt", &StereoPage::Pre_opt_Click, {{28}, {359, "50 µs"}, {360, "75 µs"}}, Pre_Frame);
}

void StereoPage::createStereo() {
    Frame_stereo = captioned<QGroupBox>("Frame_stereo", {29}, this);
    createOptions(
        Stereo_Opt, "Stereo_Opt", &StereoPage::Stereo_Opt_Click,
        {{361, "links"}, {362, "rechts"}, {363, "links = rechts"}, {364, "links = -rechts"}, {365, "links =/ rechts"}},
        Frame_stereo);
    m_pilotHeading = new QLabel(Frame_stereo);
    m_book.text(m_pilotHeading, {344, "Pilotton"});
    createSwitch(Pilot_OnOff, "Pilot_OnOff", {354, "Pilotton ein / aus"}, &StereoPage::Pilot_OnOff_Click, Frame_stereo);
    createDeviation(Pilot_Hub_Scroll, "Pilot_Hub_Scroll", "Pilot_hub_Label", {349, "Pilottonhub"},
                    &StereoPage::Pilot_Hub_Scroll_Change, Frame_stereo);
    HScroll1_Label = named<QLabel>("HScroll1_Label", Frame_stereo);
    HScroll1 = named<SettingScrollBar>("HScroll1", Frame_stereo);
    HScroll1->setScale(kLowestPilotPhase, kHighestPilotPhase, 1);
    setQuietly(HScroll1, storedPosition(m_multiplex.pilotPhase, kLowestPilotPhase, kHighestPilotPhase));
    m_book.describe(HScroll1, {350, "Pilottonphase"});
    connect(HScroll1, &QScrollBar::sliderMoved, this, &StereoPage::showPilotPhase);
    connect(HScroll1, &QScrollBar::valueChanged, this, &StereoPage::HScroll1_Change);
}

void StereoPage::createSubcarriers() {
    RDS_Frame = captioned<QGroupBox>("RDS_Frame", {342, "R D S"}, this);
    createSwitch(RDS_OnOff, "RDS_OnOff", {355, "RDS-Träger ein / aus"}, &StereoPage::RDS_OnOff_Click, RDS_Frame);
    createDeviation(RDS_Hub_Scroll, "RDS_Hub_Scroll", "RDS_Hub_Label", {351, "RDS-Hub"},
                    &StereoPage::RDS_Hub_Scroll_Change, RDS_Frame);
    // No command sets the RDS phase: the control has its range and no handler.
    RDS_Phase_Label = named<QLabel>("RDS_Phase_Label", RDS_Frame);
    RDS_Phase_Scroll = named<SettingScrollBar>("RDS_Phase_Scroll", RDS_Frame);
    RDS_Phase_Scroll->setScale(0, kHighestRdsPhase, 1);
    m_book.describe(RDS_Phase_Scroll, {352, "RDS-Phase"});

    Ari_Frame = captioned<QGroupBox>("Ari_Frame", {343, "A R I"}, this);
    createSwitch(Ari_OnOff, "Ari_OnOff", {356, "ARI ein / aus"}, &StereoPage::Ari_OnOff_Click, Ari_Frame);
    createDeviation(Ari_hub_Scroll, "Ari_hub_Scroll", "Ari_Label", {353, "ARI-Hub"}, &StereoPage::Ari_hub_Scroll_Change,
                    Ari_Frame);
    createOptions(ARI_Mode_Opt, "ARI_Mode_Opt", &StereoPage::ARI_Mode_Opt_Click,
                  {{193}, {366, "DK"}, {367, "BK"}, {368, "DK + BK"}}, Ari_Frame);
    m_areaHeading = new QLabel(Ari_Frame);
    m_book.text(m_areaHeading, {345, "Bereich"});
    createOptions(BK_Opt, "BK_Opt", &StereoPage::BK_Opt_Click,
                  {{369, "A"}, {370, "B"}, {371, "C"}, {372, "D"}, {373, "E"}, {374, "F"}}, Ari_Frame);
}

void StereoPage::createDeviation(DeviationBar& bar, const char* scroll, const char* label, const Caption& spoken,
                                 void (StereoPage::*handler)(), QWidget* frame) {
    bar.label = named<QLabel>(label, frame);
    bar.scroll = named<SettingScrollBar>(scroll, frame);
    bar.scroll->setScale(0, bar.deviation.highest, bar.deviation.step);
    m_book.describe(bar.scroll, spoken);
    connect(bar.scroll, &QScrollBar::sliderMoved, this,
            [this, &bar](int tensOfHertz) { showDeviation(bar, tensOfHertz); });
    connect(bar.scroll, &QScrollBar::valueChanged, this, handler);
}

void StereoPage::createSwitch(FlagSwitch& flag, const char* name, const Caption& spoken, void (StereoPage::*handler)(),
                              QWidget* frame) {
    flag.button = named<PictureSwitch>(name, m_with.data, frame);
    m_book.describe(flag.button, spoken);
    connect(flag.button, &PictureSwitch::clicked, this, handler);
}

template <std::size_t Count>
void StereoPage::createOptions(Choice<Count>& choice, const char* name, void (StereoPage::*handler)(int),
                               const Caption (&captions)[Count], QWidget* frame) {
    choice.options.create(name, frame);
    for (std::size_t i = 0; i < Count; ++i) m_book.text(choice.options[i], captions[i]);
    choice.options.onClick(this, handler);
}

void StereoPage::arrange() {
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
    left->addWidget(FM_Frame, 1);
    middle->addWidget(Frame_stereo, 1);
    middle->addWidget(RDS_Frame);
    right->addWidget(Ari_Frame);
    right->addWidget(m_testMode);
    right->addStretch(1);
    right->addWidget(Btn_SetRdsStereo);
    arrangeFrames();
}

void StereoPage::arrangeFrames() {
    stack(FM_Source_Opt.options, FM_Sorce_Frame);
    stack(FM_Imp_Opt.options, FM_Imp_Frame);
    stack(Pre_opt.options, Pre_Frame);
    auto* fm = new QGridLayout(FM_Frame);
    tighten(fm);
    fm->addWidget(FM_Hub_Scroll.label, 0, 0, 1, 2);
    fm->addWidget(FM_Hub_Scroll.scroll, 1, 0, 1, 2);
    fm->addWidget(FM_Sorce_Frame, 2, 0, 1, 2);
    fm->addWidget(FM_Imp_Frame, 3, 0);
    fm->addWidget(Pre_Frame, 3, 1);
    fm->setRowStretch(4, 1);

    auto* stereo = stack(Stereo_Opt.options, Frame_stereo);
    stereo->addLayout(line(m_pilotHeading, Pilot_OnOff.button));
    for (QWidget* control :
         std::initializer_list<QWidget*>{Pilot_Hub_Scroll.label, Pilot_Hub_Scroll.scroll, HScroll1_Label, HScroll1}) {
        stereo->addWidget(control);
    }

    auto* rds = new QVBoxLayout(RDS_Frame);
    tighten(rds);
    rds->addLayout(line(RDS_Hub_Scroll.label, RDS_OnOff.button));
    rds->addWidget(RDS_Hub_Scroll.scroll);
    rds->addWidget(RDS_Phase_Label);
    rds->addWidget(RDS_Phase_Scroll);

    auto* ari = new QGridLayout(Ari_Frame);
    tighten(ari);
    // Six columns: the modes take three each, the areas two.
    constexpr int kColumns = 6;
    ari->addLayout(line(Ari_hub_Scroll.label, Ari_OnOff.button), 0, 0, 1, kColumns);
    ari->addWidget(Ari_hub_Scroll.scroll, 1, 0, 1, kColumns);
    for (int i = 0; i < 4; ++i) {
        ari->addWidget(ARI_Mode_Opt.options[static_cast<std::size_t>(i)], 2 + i / 2, 3 * (i % 2), 1, 3);
    }
    ari->addWidget(m_areaHeading, 4, 0, 1, kColumns);
    for (int i = 0; i < kColumns; ++i) {
        ari->addWidget(BK_Opt.options[static_cast<std::size_t>(i)], 5 + i / 3, 2 * (i % 3), 1, 2);
        ari->setColumnStretch(i, 1);
    }
}

}  // namespace kdx
