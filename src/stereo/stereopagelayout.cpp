// How the page "FM / Stereo" is made: its controls, what they are called, which handler each one has, where they stand.
#include "stereo/stereopage.h"

#include <QGroupBox>
#include <QLabel>
#include <QPushButton>

#include "settings/storedvalue.h"
#include "stereo/numberfield.h"
#include "ui/keymarks.h"
#include "ui/layouts.h"

namespace kdx {

namespace {

constexpr int kHighestRdsPhase = 359;

/// Puts options under each other; room to spare goes below them.
template <std::size_t Count>
QBoxLayout* stack(const Choice<Count>& choice) {
    return add(column(choice.options), {kRoom});
}

/// Puts a value and the field to enter it into a line of their own.
QBoxLayout* line(QLabel* value, QWidget* number) {
    return row({{value, 1}, number});
}

/// Puts a heading and its switch into a line of their own.
QBoxLayout* line(QLabel* heading, const FlagSwitch& flag) {
    return row({{heading, 1}, flag.button});
}

}  // namespace

void StereoPage::create() {
    createFm();
    createStereo();
    createSubcarriers();
    const auto mark = [this](const auto&... choice) {
        (m_with.marks.add(choice.setting.sendKey, choice.options), ...);
    };
    mark(FM_Source_Opt, FM_Imp_Opt, Pre_opt, Stereo_Opt, ARI_Mode_Opt, BK_Opt);
    m_testMode->setParent(this);
    Btn_SetRdsStereo = captioned<QPushButton>("Btn_SetRdsStereo", {346, "&Alles senden"}, this);
    m_book.tip(Btn_SetRdsStereo, {347, "Den ganzen Datensatz an das Gerät senden"});
    connect(Btn_SetRdsStereo, &QPushButton::clicked, this, &StereoPage::setRdsStereoRequested);
}

void StereoPage::createFm() {
    FM_Frame = captioned<QGroupBox>("FM_Frame", {341, "FM"}, this);
    createDeviation(FM_Hub_Scroll, "FM_Hub_Scroll", "FM_Hub_Label2", "FM_Hub_Zahl", {348, "Gesamthub"}, FM_Frame,
                    &StereoPage::FM_Hub_Scroll_Change);
    FM_Sorce_Frame = captioned<QGroupBox>("FM_Sorce_Frame", {20}, FM_Frame);
    createOptions(FM_Source_Opt.options, "FM_Source_Opt", {{22}, {23}, {24}, {25}}, FM_Sorce_Frame,
                  &StereoPage::FM_Source_Opt_Click);
    FM_Imp_Frame = captioned<QGroupBox>("FM_Imp_Frame", {26}, FM_Frame);
    createOptions(FM_Imp_Opt.options, "FM_Imp_Opt", {{357, "600 Ohm"}, {358, "100k Ohm"}}, FM_Imp_Frame,
                  &StereoPage::FM_Imp_Opt_Click);
    Pre_Frame = captioned<QGroupBox>("Pre_Frame", {27}, FM_Frame);
    createOptions(Pre_opt.options, "Pre_opt", {{28}, {359, "50 µs"}, {360, "75 µs"}}, Pre_Frame,
                  &StereoPage::Pre_opt_Click);
}

void StereoPage::createStereo() {
    Frame_stereo = captioned<QGroupBox>("Frame_stereo", {29}, this);
    createOptions(
        Stereo_Opt.options, "Stereo_Opt",
        {{361, "links"}, {362, "rechts"}, {363, "links = rechts"}, {364, "links = -rechts"}, {365, "links =/ rechts"}},
        Frame_stereo, &StereoPage::Stereo_Opt_Click);
    m_pilotHeading = captioned<QLabel>("", {344, "Pilotton"}, Frame_stereo);
    createSwitch(Pilot_OnOff, "Pilot_OnOff", {354, "Pilotton ein / aus"}, Frame_stereo, &StereoPage::Pilot_OnOff_Click);
    createDeviation(Pilot_Hub_Scroll, "Pilot_Hub_Scroll", "Pilot_hub_Label", "Pilot_Hub_Zahl", {349, "Pilottonhub"},
                    Frame_stereo, &StereoPage::Pilot_Hub_Scroll_Change);
    HScroll1_Label = named<QLabel>("HScroll1_Label", Frame_stereo);
    HScroll1_Zahl = named<DegreeField>("HScroll1_Zahl", Frame_stereo);
    HScroll1 = named<SettingScrollBar>("HScroll1", Frame_stereo);
    HScroll1->setScale(kLowestPilotPhase, kHighestPilotPhase, 1);
    setQuietly(HScroll1, storedPosition(m_multiplex.pilotPhase, kLowestPilotPhase, kHighestPilotPhase));
    for (QWidget* control : std::initializer_list<QWidget*>{HScroll1, HScroll1_Label})
        m_with.marks.add(setting::kPilotPhase.sendKey, control);
    m_book.describe(HScroll1, {350, "Pilottonphase"});
    tie(m_with, HScroll1_Zahl, HScroll1, setting::kPilotPhase.sendKey);
    m_book.describe(HScroll1_Zahl, {350, "Pilottonphase"});
    connect(HScroll1, &QScrollBar::sliderMoved, this, &StereoPage::showPilotPhase);
    connect(HScroll1, &QScrollBar::valueChanged, this, &StereoPage::HScroll1_Change);
}

void StereoPage::createSubcarriers() {
    RDS_Frame = captioned<QGroupBox>("RDS_Frame", {342, "R D S"}, this);
    createSwitch(RDS_OnOff, "RDS_OnOff", {355, "RDS-Träger ein / aus"}, RDS_Frame, &StereoPage::RDS_OnOff_Click);
    createDeviation(RDS_Hub_Scroll, "RDS_Hub_Scroll", "RDS_Hub_Label", "RDS_Hub_Zahl", {351, "RDS-Hub"}, RDS_Frame,
                    &StereoPage::RDS_Hub_Scroll_Change);
    // No command sets the RDS phase: the control has its range and no handler.
    RDS_Phase_Label = named<QLabel>("RDS_Phase_Label", RDS_Frame);
    RDS_Phase_Scroll = named<SettingScrollBar>("RDS_Phase_Scroll", RDS_Frame);
    RDS_Phase_Scroll->setScale(0, kHighestRdsPhase, 1);
    m_book.describe(RDS_Phase_Scroll, {352, "RDS-Phase"});

    Ari_Frame = captioned<QGroupBox>("Ari_Frame", {343, "A R I"}, this);
    createSwitch(Ari_OnOff, "Ari_OnOff", {356, "ARI ein / aus"}, Ari_Frame, &StereoPage::Ari_OnOff_Click);
    createDeviation(Ari_hub_Scroll, "Ari_hub_Scroll", "Ari_Label", "Ari_hub_Zahl", {353, "ARI-Hub"}, Ari_Frame,
                    &StereoPage::Ari_hub_Scroll_Change);
    createOptions(ARI_Mode_Opt.options, "ARI_Mode_Opt", {{193}, {366, "DK"}, {367, "BK"}, {368, "DK + BK"}}, Ari_Frame,
                  &StereoPage::ARI_Mode_Opt_Click);
    m_areaHeading = captioned<QLabel>("", {345, "Bereich"}, Ari_Frame);
    createOptions(BK_Opt.options, "BK_Opt", {{369, "A"}, {370, "B"}, {371, "C"}, {372, "D"}, {373, "E"}, {374, "F"}},
                  Ari_Frame, &StereoPage::BK_Opt_Click);
}

void StereoPage::createDeviation(DeviationBar& bar, const char* scroll, const char* label, const char* number,
                                 const Caption& spoken, QWidget* frame, void (StereoPage::*handler)()) {
    bar.label = named<QLabel>(label, frame);
    bar.number = named<KilohertzField>(number, frame);
    bar.scroll = named<SettingScrollBar>(scroll, frame);
    bar.scroll->setScale(0, bar.deviation.highest, bar.deviation.step);
    m_book.describe(bar.scroll, spoken);
    const char* const key = bar.setting.sendKey;
    tie(m_with, bar.number, bar.scroll, key);
    m_with.marks.add(key, bar.scroll);
    m_with.marks.add(key, bar.label);
    m_book.describe(bar.number, spoken);
    connect(bar.scroll, &QScrollBar::sliderMoved, this,
            [this, &bar](int tensOfHertz) { showDeviation(bar, tensOfHertz); });
    connect(bar.scroll, &QScrollBar::valueChanged, this, handler);
}

void StereoPage::createSwitch(FlagSwitch& flag, const char* name, const Caption& spoken, QWidget* frame,
                              void (StereoPage::*handler)()) {
    flag.button = wired<PictureSwitch>(name, &PictureSwitch::clicked, handler, m_with.data, frame);
    m_book.describe(flag.button, spoken);
    m_with.marks.add(flag.setting.sendKey, flag.button);
}

void StereoPage::arrange() {
    arrangeFrames();
    auto* columns = grid({{column({{FM_Frame, 1}}), column({{Frame_stereo, 1}, RDS_Frame}),
                           column({Ari_Frame, m_testMode, kRoom, Btn_SetRdsStereo})}});
    columns->setHorizontalSpacing(2 * kGap);
    for (int i = 0; i < columns->columnCount(); ++i) columns->setColumnStretch(i, 1);
    // Room to spare goes below the frames: their controls stay together.
    columns->setRowStretch(1, 1);
    layOut(this, columns, kPageMargin);
}

void StereoPage::arrangeFrames() {
    layOut(FM_Sorce_Frame, stack(FM_Source_Opt));
    layOut(FM_Imp_Frame, stack(FM_Imp_Opt));
    layOut(Pre_Frame, stack(Pre_opt));
    auto* fm = grid({{{line(FM_Hub_Scroll.label, FM_Hub_Scroll.number), 2}},
                     {{FM_Hub_Scroll.scroll, 2}},
                     {{FM_Sorce_Frame, 2}},
                     {FM_Imp_Frame, Pre_Frame}});
    fm->setRowStretch(4, 1);
    layOut(FM_Frame, fm);

    layOut(Frame_stereo, add(stack(Stereo_Opt),
                             {line(m_pilotHeading, Pilot_OnOff), line(Pilot_Hub_Scroll.label, Pilot_Hub_Scroll.number),
                              Pilot_Hub_Scroll.scroll, line(HScroll1_Label, HScroll1_Zahl), HScroll1}));
    layOut(RDS_Frame,
           column({line(RDS_Hub_Scroll.label, RDS_OnOff), row({{RDS_Hub_Scroll.scroll, 1}, RDS_Hub_Scroll.number}),
                   RDS_Phase_Label, RDS_Phase_Scroll}));

    // Six columns: the modes take three each, the areas two.
    const auto& mode = ARI_Mode_Opt.options;
    const auto& area = BK_Opt.options;
    auto* ari = grid({{{line(Ari_hub_Scroll.label, Ari_OnOff), 6}},
                      {{row({{Ari_hub_Scroll.scroll, 1}, Ari_hub_Scroll.number}), 6}},
                      {{mode[0], 3}, {mode[1], 3}},
                      {{mode[2], 3}, {mode[3], 3}},
                      {{m_areaHeading, 6}},
                      {{area[0], 2}, {area[1], 2}, {area[2], 2}},
                      {{area[3], 2}, {area[4], 2}, {area[5], 2}}});
    for (int i = 0; i < ari->columnCount(); ++i) ari->setColumnStretch(i, 1);
    layOut(Ari_Frame, ari);
}

}  // namespace kdx
