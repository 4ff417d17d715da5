#include "tmc/tmcbuilder.h"

#include "base/numbers.h"
#include "settings/datafolder.h"
#include "tmc/bitdisplay.h"
#include "tmc/groupcode.h"
#include "tmc/shownlist.h"
#include "tmc/valuelabel.h"
#include "ui/text.h"

#include <QAbstractItemView>
#include <QGridLayout>
#include <QVBoxLayout>

namespace kdx {

namespace {

constexpr int kHexDigits = 8;

void fillZeroToSeven(QComboBox* combo) {
    const QSignalBlocker quiet(combo);
    combo->clear();
    for (int number = 0; number < 8; ++number) combo->addItem(QString::number(number));
}

/// The number of the chosen event or location.
double chosenNumber(const QComboBox* combo) {
    return entryNumber(toBytes(combo->currentText()));
}

}  // namespace

TmcBuilder::TmcBuilder(const PageContext& with, QWidget* parent) : Page(with, parent) {
    create();
    arrange();
    TMCGruppe8Maker();
}

void TmcBuilder::create() {
    createLists();

    TMC_Frame1 = captioned<QGroupBox>("TMC_Frame1", {201}, this);
    Tmc_richtung.create("Tmc_richtung", TMC_Frame1);
    m_book.text(Tmc_richtung[0], {202});
    m_book.text(Tmc_richtung[1], {203});
    Tmc_richtung.onClick(this, &TmcBuilder::Tmc_richtung_Click);

    TMC_Var_Label = captioned<QLabel>("TMC_Var_Label", {204}, this);
    TMC_Var_Combo = named<QComboBox>("TMC_Var_Combo", this);
    TMC_Var_Combo->setEditable(true);
    TMC_Var_Combo->setInsertPolicy(QComboBox::NoInsert);
    TMC_Var_Label->setBuddy(TMC_Var_Combo);
    // An extent may be typed as well as chosen, also one that reads as before.
    connect(TMC_Var_Combo, &QComboBox::activated, this, &TmcBuilder::TMC_Var_Combo_Click);
    connect(TMC_Var_Combo, &QComboBox::editTextChanged, this, &TmcBuilder::TMC_Var_Combo_Click);

    createDuration();

    TMC_Div = captioned<QCheckBox>("TMC_Div", {564, "Diversion"}, this);
    connect(TMC_Div, &QCheckBox::toggled, this, &TmcBuilder::TMC_Div_Click);
    TMC_F_Check = captioned<QCheckBox>("TMC_F_Check", {569, "F - Feld"}, this);
    connect(TMC_F_Check, &QCheckBox::toggled, this, &TmcBuilder::TMC_F_Check_Click);
    TMC_T_Check = captioned<QCheckBox>("TMC_T_Check", {570, "T - Feld"}, this);
    connect(TMC_T_Check, &QCheckBox::toggled, this, &TmcBuilder::TMC_T_Check_Click);

    createCode();
}

void TmcBuilder::createLists() {
    Label3 = captioned<QLabel>("Label3", {205}, this);
    TMC_Event_Combo = named<QComboBox>("TMC_Event_Combo", this);
    connect(TMC_Event_Combo, &QComboBox::activated, this, &TmcBuilder::TMC_Event_Combo_Click);
    TMC_Event_Hex_Label = named<ValueLabel>("TMC_Event_Hex_Label", this);
    m_book.tip(TMC_Event_Hex_Label, {562, "Eventnummer, hexadezimal"});
    Label4 = captioned<QLabel>("Label4", {206}, this);
    TMC_Loc_Combo = named<QComboBox>("TMC_Loc_Combo", this);
    connect(TMC_Loc_Combo, &QComboBox::activated, this, &TmcBuilder::TMC_Loc_Combo_Click);
    TMC_Local_Hex_Label = named<ValueLabel>("TMC_Local_Hex_Label", this);
    m_book.tip(TMC_Local_Hex_Label, {563, "Locationnummer, hexadezimal"});
    Label3->setBuddy(TMC_Event_Combo);
    Label4->setBuddy(TMC_Loc_Combo);
    for (QComboBox* combo : {TMC_Event_Combo, TMC_Loc_Combo}) {
        combo->setSizeAdjustPolicy(QComboBox::AdjustToMinimumContentsLengthWithIcon);
        combo->setMinimumContentsLength(20);
        combo->view()->setFont(fixedPitch(QStringLiteral("Courier New")));
    }
    for (ValueLabel* number : {TMC_Event_Hex_Label, TMC_Local_Hex_Label}) number->makeRoomFor(kHexDigits);
}

void TmcBuilder::createDuration() {
    Frame5 = captioned<QGroupBox>("Frame5", {568, "duration / persistence"}, this);
    TMC_DP1_Check = captioned<QCheckBox>("TMC_DP1_Check", {565, "DP 1"}, Frame5);
    connect(TMC_DP1_Check, &QCheckBox::toggled, this, &TmcBuilder::TMC_DP1_Check_Click);
    TMC_DP2_Check = captioned<QCheckBox>("TMC_DP2_Check", {566, "DP 2"}, Frame5);
    connect(TMC_DP2_Check, &QCheckBox::toggled, this, &TmcBuilder::TMC_DP2_Check_Click);
    TMC_DP3Check = captioned<QCheckBox>("TMC_DP3Check", {567, "DP 3"}, Frame5);
    connect(TMC_DP3Check, &QCheckBox::toggled, this, &TmcBuilder::TMC_DP3Check_Click);
    DurationCombo = named<QComboBox>("DurationCombo", Frame5);
    m_book.spokenAs(DurationCombo, Frame5);
    // Only the user's choice: the boxes set the combo in turn, and the two would call each other for ever.
    connect(DurationCombo, &QComboBox::activated, this, &TmcBuilder::DurationCombo_Click);
}

void TmcBuilder::createCode() {
    TMCInfoOnOff = named<QPushButton>("TMCInfoOnOff", QStringLiteral("<"), this);
    TMCInfoOnOff->setFixedWidth(fontMetrics().horizontalAdvance(QStringLiteral("<")) + 18);
    m_book.describe(TMCInfoOnOff, {572, "Bitanzeige ein / aus"});
    connect(TMCInfoOnOff, &QPushButton::clicked, this, &TmcBuilder::TMCInfoOnOff_Click);
    m_bits = new BitDisplay(m_book, this);
    connect(m_bits, &BitDisplay::changed, this, &TmcBuilder::TMCGruppe8Maker);

    m_codeHeading = new QLabel(this);
    m_book.text(m_codeHeading, {571, "Gruppe 8A"});
    TMC_Gr8_Label = named<ValueLabel>("TMC_Gr8_Label", this);
    QFont font = TMC_Gr8_Label->font();
    font.setFamilies(arialFamilies());
    TMC_Gr8_Label->setFont(font);
    TMC_Gr8_Label->setTextInteractionFlags(Qt::TextSelectableByMouse);
    TMC_Gr8_Label->makeRoomFor(static_cast<int>(kGroupCodeLength) + 1);
}

void TmcBuilder::arrange() {
    auto* layout = new QVBoxLayout(this);
    tighten(layout, 0);
    layout->addLayout(arrangeLists());
    layout->addLayout(arrangeFields());
    layout->addLayout(arrangeCode());
}

QLayout* TmcBuilder::arrangeLists() {
    auto* grid = new QGridLayout;
    tighten(grid, 0);
    grid->setColumnStretch(1, 1);
    grid->addWidget(Label3, 0, 0);
    grid->addWidget(TMC_Event_Combo, 0, 1);
    grid->addWidget(TMC_Event_Hex_Label, 0, 2);
    grid->addWidget(Label4, 1, 0);
    grid->addWidget(TMC_Loc_Combo, 1, 1);
    grid->addWidget(TMC_Local_Hex_Label, 1, 2);
    return grid;
}

QLayout* TmcBuilder::arrangeFields() {
    auto* directions = new QVBoxLayout(TMC_Frame1);
    tighten(directions);
    for (QRadioButton* direction : Tmc_richtung) directions->addWidget(direction);

    auto* extent = new QVBoxLayout;
    tighten(extent, 0);
    extent->addWidget(TMC_Var_Label);
    extent->addWidget(TMC_Var_Combo, 0, Qt::AlignLeft);
    extent->addStretch();

    auto* duration = new QGridLayout(Frame5);
    tighten(duration);
    duration->addWidget(TMC_DP1_Check, 0, 0);
    duration->addWidget(TMC_DP2_Check, 0, 1);
    duration->addWidget(TMC_DP3Check, 0, 2);
    duration->addWidget(DurationCombo, 1, 0, 1, 3, Qt::AlignLeft);

    auto* flags = new QVBoxLayout;
    tighten(flags, 0);
    for (QCheckBox* flag : {TMC_Div, TMC_F_Check, TMC_T_Check}) flags->addWidget(flag);

    auto* row = new QHBoxLayout;
    tighten(row, 0);
    row->setSpacing(2 * kGap);
    row->addWidget(TMC_Frame1);
    row->addLayout(extent);
    row->addStretch(1);
    row->addWidget(Frame5);
    row->addStretch(1);
    row->addLayout(flags);
    return row;
}

QLayout* TmcBuilder::arrangeCode() {
    auto* code = new QGridLayout;
    tighten(code, 0);
    code->addWidget(m_codeHeading, 0, 0, Qt::AlignHCenter);
    code->addWidget(TMC_Gr8_Label, 1, 0);

    auto* row = new QHBoxLayout;
    tighten(row, 0);
    row->addWidget(TMCInfoOnOff, 0, Qt::AlignBottom);
    row->addSpacing(kGap);
    row->addWidget(m_bits);
    row->addStretch(1);
    row->addLayout(code);
    return row;
}

void TmcBuilder::label() {
    Page::label();
    TMC_Event_Combo->setPlaceholderText(caption({560, "Eventauswahl"}));
    TMC_Loc_Combo->setPlaceholderText(caption({561, "Locationauswahl"}));
}

void TmcBuilder::load() {
    fillZeroToSeven(TMC_Var_Combo);
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

QString TmcBuilder::groupCode() const {
    return TMC_Gr8_Label->text();
}

void TmcBuilder::TMC_Event_Combo_Click() {
    const double number = chosenNumber(TMC_Event_Combo);
    TMC_Event_Hex_Label->setText(toText(hexadecimal(number)));
    m_bits->set(BitDisplay::Event, number);
}

void TmcBuilder::TMC_Loc_Combo_Click() {
    const double number = chosenNumber(TMC_Loc_Combo);
    TMC_Local_Hex_Label->setText(toText(hexadecimal(number)));
    m_bits->set(BitDisplay::Location, number);
}

void TmcBuilder::TMC_Var_Combo_Click() {
    m_bits->set(BitDisplay::Extent, leadingNumber(toBytes(TMC_Var_Combo->currentText())));
}

void TmcBuilder::Tmc_richtung_Click(int index) {
    m_bits->set(BitDisplay::U, index == 1 ? 1 : 0);
}

void TmcBuilder::TMC_Div_Click() {
    m_bits->set(BitDisplay::D, TMC_Div->isChecked() ? 1 : 0);
}

void TmcBuilder::TMC_F_Check_Click() {
    m_bits->set(BitDisplay::F, TMC_F_Check->isChecked() ? 1 : 0);
}

void TmcBuilder::TMC_T_Check_Click() {
    m_bits->set(BitDisplay::T, TMC_T_Check->isChecked() ? 1 : 0);
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
    m_bits->set(BitDisplay::Dp, duration);
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
    m_bits->showFields(show);
}

void TmcBuilder::TMCGruppe8Maker() {
    TMC_Gr8_Label->setText(toText(kdx::groupCode(m_bits->message())));
}

}  // namespace kdx
