#include "tmc/tmcbuilder.h"

#include "base/numbers.h"
#include "settings/captions.h"
#include "settings/datafolder.h"
#include "tmc/groupcode.h"
#include "tmc/shownlist.h"
#include "ui/text.h"

#include <QAbstractItemView>
#include <QGridLayout>
#include <QVBoxLayout>

namespace kdx {

namespace {

constexpr const char* kNotSet = "-";
constexpr int kEventBits = 11;
constexpr int kLocationBits = 16;
constexpr int kThreeBits = 3;

// Headings of the bit display, from left to right, with the number of their caption.
struct BitHeading {
    int caption;
    const char* design;
};
constexpr std::array kBitHeadings = {
    BitHeading{574, "T"}, BitHeading{575, "F"},      BitHeading{576, "DP"},    BitHeading{577, "D"},
    BitHeading{578, "U"}, BitHeading{579, "Extent"}, BitHeading{580, "Event"}, BitHeading{581, "Location"},
};

void fillZeroToSeven(QComboBox* combo) {
    combo->clear();
    for (int number = 0; number < 8; ++number) combo->addItem(QString::number(number));
}

QString bit(bool set) {
    return set ? QStringLiteral("1") : QStringLiteral("0");
}

/// A label that shows a value: the look of a box that cannot be written in.
QLabel* valueLabel(const char* name, QWidget* parent) {
    auto* label = named<QLabel>(name, parent);
    label->setFrameStyle(QFrame::Panel | QFrame::Sunken);
    label->setTextFormat(Qt::PlainText);
    label->setAlignment(Qt::AlignCenter);
    return label;
}

int widthOf(const QLabel* label, int characters) {
    return label->fontMetrics().horizontalAdvance(QString(characters, QLatin1Char('0'))) + 8;
}

}  // namespace

TmcBuilder::TmcBuilder(const PageContext& with, QWidget* parent) : QWidget(parent), m_with(with) {
    auto* layout = new QVBoxLayout(this);
    tighten(layout, 0);
    layout->addLayout(placeLists());
    layout->addLayout(placeFields());
    layout->addLayout(placeCode());
    wire();
    label();
    TMCGruppe8Maker();
}

QLayout* TmcBuilder::placeLists() {
    auto* grid = new QGridLayout;
    tighten(grid, 0);
    grid->setColumnStretch(1, 1);
    Label3 = named<QLabel>("Label3", this);
    TMC_Event_Combo = named<QComboBox>("TMC_Event_Combo", this);
    TMC_Event_Hex_Label = valueLabel("TMC_Event_Hex_Label", this);
    Label4 = named<QLabel>("Label4", this);
    TMC_Loc_Combo = named<QComboBox>("TMC_Loc_Combo", this);
    TMC_Local_Hex_Label = valueLabel("TMC_Local_Hex_Label", this);
    Label3->setBuddy(TMC_Event_Combo);
    Label4->setBuddy(TMC_Loc_Combo);
    for (QComboBox* combo : {TMC_Event_Combo, TMC_Loc_Combo}) {
        combo->setSizeAdjustPolicy(QComboBox::AdjustToMinimumContentsLengthWithIcon);
        combo->setMinimumContentsLength(20);
        combo->view()->setFont(fixedPitch(QStringLiteral("Courier New")));
    }
    for (QLabel* number : {TMC_Event_Hex_Label, TMC_Local_Hex_Label}) number->setMinimumWidth(widthOf(number, 8));
    grid->addWidget(Label3, 0, 0);
    grid->addWidget(TMC_Event_Combo, 0, 1);
    grid->addWidget(TMC_Event_Hex_Label, 0, 2);
    grid->addWidget(Label4, 1, 0);
    grid->addWidget(TMC_Loc_Combo, 1, 1);
    grid->addWidget(TMC_Local_Hex_Label, 1, 2);
    return grid;
}

QLayout* TmcBuilder::placeFields() {
    TMC_Frame1 = named<QGroupBox>("TMC_Frame1", this);
    auto* directions = new QVBoxLayout(TMC_Frame1);
    tighten(directions);
    Tmc_richtung.create("Tmc_richtung", TMC_Frame1);
    for (QRadioButton* direction : Tmc_richtung) directions->addWidget(direction);

    TMC_Var_Label = named<QLabel>("TMC_Var_Label", this);
    TMC_Var_Combo = named<QComboBox>("TMC_Var_Combo", this);
    TMC_Var_Combo->setEditable(true);
    TMC_Var_Combo->setInsertPolicy(QComboBox::NoInsert);
    TMC_Var_Label->setBuddy(TMC_Var_Combo);
    auto* extent = new QVBoxLayout;
    tighten(extent, 0);
    extent->addWidget(TMC_Var_Label);
    extent->addWidget(TMC_Var_Combo, 0, Qt::AlignLeft);
    extent->addStretch();

    Frame5 = named<QGroupBox>("Frame5", this);
    auto* duration = new QGridLayout(Frame5);
    tighten(duration);
    TMC_DP1_Check = named<QCheckBox>("TMC_DP1_Check", Frame5);
    TMC_DP2_Check = named<QCheckBox>("TMC_DP2_Check", Frame5);
    TMC_DP3Check = named<QCheckBox>("TMC_DP3Check", Frame5);
    DurationCombo = named<QComboBox>("DurationCombo", Frame5);
    duration->addWidget(TMC_DP1_Check, 0, 0);
    duration->addWidget(TMC_DP2_Check, 0, 1);
    duration->addWidget(TMC_DP3Check, 0, 2);
    duration->addWidget(DurationCombo, 1, 0, 1, 3, Qt::AlignLeft);

    auto* row = new QHBoxLayout;
    tighten(row, 0);
    row->setSpacing(2 * kGap);
    row->addWidget(TMC_Frame1);
    row->addLayout(extent);
    row->addStretch(1);
    row->addWidget(Frame5);
    row->addStretch(1);
    row->addLayout(placeFlags());
    return row;
}

QLayout* TmcBuilder::placeFlags() {
    TMC_Div = named<QCheckBox>("TMC_Div", this);
    TMC_F_Check = named<QCheckBox>("TMC_F_Check", this);
    TMC_T_Check = named<QCheckBox>("TMC_T_Check", this);
    auto* flags = new QVBoxLayout;
    tighten(flags, 0);
    for (QCheckBox* flag : {TMC_Div, TMC_F_Check, TMC_T_Check}) flags->addWidget(flag);
    return flags;
}

QLabel* TmcBuilder::placeBits(const char* name, std::size_t field, int bits, QGridLayout* grid) {
    const int column = static_cast<int>(field);
    m_bitHeadings.at(field) = new QLabel(this);
    grid->addWidget(m_bitHeadings.at(field), 0, column, Qt::AlignHCenter);
    auto* label = valueLabel(name, this);
    label->setText(QLatin1String(kNotSet));
    label->setMinimumWidth(widthOf(label, bits));
    grid->addWidget(label, 1, column, Qt::AlignHCenter);
    return label;
}

QLayout* TmcBuilder::placeCode() {
    TMCInfoOnOff = named<QPushButton>("TMCInfoOnOff", QStringLiteral("<"), this);
    TMCInfoOnOff->setFixedWidth(fontMetrics().horizontalAdvance(QStringLiteral("<")) + 18);
    auto* bits = new QGridLayout;
    tighten(bits, 0);
    TMCBL3_T = placeBits("TMCBL3_T", 0, 1, bits);
    TMCBL3_F = placeBits("TMCBL3_F", 1, 1, bits);
    TMCBL3_DP = placeBits("TMCBL3_DP", 2, kThreeBits, bits);
    TMCBL3_D = placeBits("TMCBL3_D", 3, 1, bits);
    TMCBL3_U = placeBits("TMCBL3_U", 4, 1, bits);
    TMCBL3_Extent = placeBits("TMCBL3_Extent", 5, kThreeBits, bits);
    TMCBL3_Event = placeBits("TMCBL3_Event", 6, kEventBits, bits);
    TMCBL3_Local = placeBits("TMCBL3_Local", 7, kLocationBits, bits);

    m_codeHeading = new QLabel(this);
    TMC_Gr8_Label = valueLabel("TMC_Gr8_Label", this);
    QFont font = TMC_Gr8_Label->font();
    font.setFamilies(arialFamilies());
    TMC_Gr8_Label->setFont(font);
    TMC_Gr8_Label->setTextInteractionFlags(Qt::TextSelectableByMouse);
    TMC_Gr8_Label->setMinimumWidth(widthOf(TMC_Gr8_Label, static_cast<int>(kGroupCodeLength) + 1));
    auto* code = new QGridLayout;
    tighten(code, 0);
    code->addWidget(m_codeHeading, 0, 0, Qt::AlignHCenter);
    code->addWidget(TMC_Gr8_Label, 1, 0);

    auto* row = new QHBoxLayout;
    tighten(row, 0);
    row->addWidget(TMCInfoOnOff, 0, Qt::AlignBottom);
    row->addSpacing(kGap);
    row->addLayout(bits);
    row->addStretch(1);
    row->addLayout(code);
    return row;
}

void TmcBuilder::wire() {
    connect(TMC_Event_Combo, &QComboBox::activated, this, &TmcBuilder::TMC_Event_Combo_Click);
    connect(TMC_Loc_Combo, &QComboBox::activated, this, &TmcBuilder::TMC_Loc_Combo_Click);
    // An extent may be typed as well as chosen, also one that reads as before.
    connect(TMC_Var_Combo, &QComboBox::activated, this, &TmcBuilder::TMC_Var_Combo_Click);
    connect(TMC_Var_Combo, &QComboBox::editTextChanged, this, &TmcBuilder::TMC_Var_Combo_Click);
    for (std::size_t i = 0; i < Tmc_richtung.size(); ++i) {
        connect(Tmc_richtung[i], &QRadioButton::toggled, this, [this, i](bool chosen) {
            if (chosen) Tmc_richtung_Click(static_cast<int>(i));
        });
    }
    connect(TMC_Div, &QCheckBox::toggled, this, &TmcBuilder::TMC_Div_Click);
    connect(TMC_F_Check, &QCheckBox::toggled, this, &TmcBuilder::TMC_F_Check_Click);
    connect(TMC_T_Check, &QCheckBox::toggled, this, &TmcBuilder::TMC_T_Check_Click);
    connect(TMC_DP1_Check, &QCheckBox::toggled, this, &TmcBuilder::TMC_DP1_Check_Click);
    connect(TMC_DP2_Check, &QCheckBox::toggled, this, &TmcBuilder::TMC_DP2_Check_Click);
    connect(TMC_DP3Check, &QCheckBox::toggled, this, &TmcBuilder::TMC_DP3Check_Click);
    // Only the user's choice: the boxes set the combo in turn, and the two would call each other for ever.
    connect(DurationCombo, &QComboBox::activated, this, &TmcBuilder::DurationCombo_Click);
    connect(TMCInfoOnOff, &QPushButton::clicked, this, &TmcBuilder::TMCInfoOnOff_Click);
}

void TmcBuilder::label() {
    const Captions& captions = m_with.captions;
    const auto own = [&captions](int number, std::string_view design) { return toText(captions.own(number, design)); };
    TMC_Frame1->setTitle(toText(captions.text(201)));
    Tmc_richtung[0]->setText(toText(captions.text(202)));
    Tmc_richtung[1]->setText(toText(captions.text(203)));
    TMC_Var_Label->setText(toText(captions.text(204)));
    Label3->setText(toText(captions.text(205)));
    Label4->setText(toText(captions.text(206)));
    TMC_Event_Combo->setPlaceholderText(own(560, "Eventauswahl"));
    TMC_Loc_Combo->setPlaceholderText(own(561, "Locationauswahl"));
    TMC_Event_Hex_Label->setToolTip(own(562, "Eventnummer, hexadezimal"));
    TMC_Local_Hex_Label->setToolTip(own(563, "Locationnummer, hexadezimal"));
    TMC_Div->setText(own(564, "Diversion"));
    TMC_DP1_Check->setText(own(565, "DP 1"));
    TMC_DP2_Check->setText(own(566, "DP 2"));
    TMC_DP3Check->setText(own(567, "DP 3"));
    Frame5->setTitle(own(568, "duration / persistence"));
    DurationCombo->setAccessibleName(Frame5->title());
    TMC_F_Check->setText(own(569, "F - Feld"));
    TMC_T_Check->setText(own(570, "T - Feld"));
    m_codeHeading->setText(own(571, "Gruppe 8A"));
    TMCInfoOnOff->setAccessibleName(own(572, "Bitanzeige ein / aus"));
    TMCInfoOnOff->setToolTip(TMCInfoOnOff->accessibleName());
    for (std::size_t field = 0; field < kFields; ++field) {
        m_bitHeadings[field]->setText(own(kBitHeadings[field].caption, kBitHeadings[field].design));
    }
}

void TmcBuilder::setUp() {
    {
        const QSignalBlocker quiet(TMC_Var_Combo);
        fillZeroToSeven(TMC_Var_Combo);
    }
    fillZeroToSeven(DurationCombo);
    TMCInfoOnOff->setText(QStringLiteral("<"));
    TMCInfoOnOff_Click();
}

void TmcBuilder::reloadLists() {
    takeAllSteps({[this] { fill(TMC_Event_Combo, kEventList); }, [this] { fill(TMC_Loc_Combo, kLocationList); }});
}

void TmcBuilder::fill(QComboBox* combo, const char* fileName) {
    const QString chosen = combo->currentText();
    combo->clear();
    combo->addItems(loadShownList(m_with, fileName));
    combo->setCurrentIndex(chosen.isEmpty() ? -1 : combo->findText(chosen));
}

void TmcBuilder::TMC_Event_Combo_Click() {
    const double number = entryNumber(toBytes(TMC_Event_Combo->currentText()));
    TMC_Event_Hex_Label->setText(toText(hexadecimal(number)));
    TMCBL3_Event->setText(toText(lastBits(number, kEventBits)));
    TMCGruppe8Maker();
}

void TmcBuilder::TMC_Loc_Combo_Click() {
    const double number = entryNumber(toBytes(TMC_Loc_Combo->currentText()));
    TMC_Local_Hex_Label->setText(toText(hexadecimal(number)));
    TMCBL3_Local->setText(toText(lastBits(number, kLocationBits)));
    TMCGruppe8Maker();
}

void TmcBuilder::TMC_Var_Combo_Click() {
    TMCBL3_Extent->setText(toText(lastBits(leadingNumber(toBytes(TMC_Var_Combo->currentText())), kThreeBits)));
    TMCGruppe8Maker();
}

void TmcBuilder::Tmc_richtung_Click(int index) {
    TMCBL3_U->setText(bit(index == 1));
    TMCGruppe8Maker();
}

void TmcBuilder::TMC_Div_Click() {
    TMCBL3_D->setText(bit(TMC_Div->isChecked()));
    TMCGruppe8Maker();
}

void TmcBuilder::TMC_F_Check_Click() {
    TMCBL3_F->setText(bit(TMC_F_Check->isChecked()));
    TMCGruppe8Maker();
}

void TmcBuilder::TMC_T_Check_Click() {
    TMCBL3_T->setText(bit(TMC_T_Check->isChecked()));
    TMCGruppe8Maker();
}

void TmcBuilder::TMC_DP1_Check_Click() {
    m_dp1Weight = TMC_DP1_Check->isChecked() ? 4 : 0;
    showDuration();
}

void TmcBuilder::TMC_DP2_Check_Click() {
    m_dp2Weight = TMC_DP2_Check->isChecked() ? 2 : 0;
    showDuration();
}

void TmcBuilder::TMC_DP3Check_Click() {
    m_dp3Weight = TMC_DP3Check->isChecked() ? 1 : 0;
    showDuration();
}

void TmcBuilder::showDuration() {
    const int duration = m_dp1Weight + m_dp2Weight + m_dp3Weight;
    TMCBL3_DP->setText(toText(lastBits(duration, kThreeBits)));
    TMCGruppe8Maker();
    if (DurationCombo->count() > 0) DurationCombo->setCurrentIndex(duration);
}

void TmcBuilder::DurationCombo_Click() {
    // Taken once: each box that changes moves the combo to its own sum.
    const int duration = DurationCombo->currentText().toInt();
    TMC_DP1_Check->setChecked((duration & 4) != 0);
    TMC_DP2_Check->setChecked((duration & 2) != 0);
    TMC_DP3Check->setChecked((duration & 1) != 0);
    // Boxes that stand as they should already say nothing: a first "0" must reach the display all the same.
    showDuration();
}

void TmcBuilder::TMCInfoOnOff_Click() {
    const bool show = TMCInfoOnOff->text() == QLatin1String(">");
    TMCInfoOnOff->setText(show ? QStringLiteral("<") : QStringLiteral(">"));
    for (QLabel* bits :
         {TMCBL3_T, TMCBL3_F, TMCBL3_DP, TMCBL3_D, TMCBL3_U, TMCBL3_Extent, TMCBL3_Event, TMCBL3_Local}) {
        bits->setVisible(show);
    }
    for (QLabel* heading : m_bitHeadings) heading->setVisible(show);
}

void TmcBuilder::TMCGruppe8Maker() {
    const auto bits = [](const QLabel* label) { return toBytes(label->text()); };
    const GroupBits message{bits(TMCBL3_T), bits(TMCBL3_F),      bits(TMCBL3_DP),    bits(TMCBL3_D),
                            bits(TMCBL3_U), bits(TMCBL3_Extent), bits(TMCBL3_Event), bits(TMCBL3_Local)};
    TMC_Gr8_Label->setText(toText(kdx::groupCode(message)));
}

}  // namespace kdx
