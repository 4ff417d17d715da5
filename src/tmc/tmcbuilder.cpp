#include "tmc/tmcbuilder.h"

#include "base/numbers.h"
#include "settings/datafolder.h"
#include "settings/programstate.h"
#include "tmc/groupcode.h"
#include "tmc/shownlist.h"
#include "ui/layouts.h"
#include "ui/text.h"
#include "ui/valuestate.h"

namespace kdx {

namespace {

constexpr int kHexDigits = 8;

void fillZeroToSeven(QComboBox* combo) {
    const QSignalBlocker quiet(combo);
    combo->clear();
    for (int number = 0; number < 8; ++number) combo->addItem(QString::number(number));
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
    createOptions(Tmc_richtung, "Tmc_richtung", {{202}, {203}}, TMC_Frame1, &TmcBuilder::Tmc_richtung_Click);

    // An extent may be typed as well as chosen, also one that reads as before.
    TMC_Var_Combo = wired<QComboBox>("TMC_Var_Combo", &QComboBox::activated, &TmcBuilder::TMC_Var_Combo_Click, this);
    TMC_Var_Combo->setEditable(true);
    TMC_Var_Combo->setInsertPolicy(QComboBox::NoInsert);
    connect(TMC_Var_Combo, &QComboBox::editTextChanged, this, &TmcBuilder::TMC_Var_Combo_Click);
    TMC_Var_Label = heading("TMC_Var_Label", {204}, TMC_Var_Combo);

    createDuration();

    constexpr auto kToggled = &QCheckBox::toggled;  // also when the program sets them
    TMC_Div = captioned<QCheckBox>("TMC_Div", {564, "Diversion"}, this, kToggled, &TmcBuilder::TMC_Div_Click);
    TMC_F_Check =
        captioned<QCheckBox>("TMC_F_Check", {569, "F - Feld"}, this, kToggled, &TmcBuilder::TMC_F_Check_Click);
    TMC_T_Check =
        captioned<QCheckBox>("TMC_T_Check", {570, "T - Feld"}, this, kToggled, &TmcBuilder::TMC_T_Check_Click);

    createCode();
}

void TmcBuilder::createLists() {
    TMC_Event_Combo =
        wired<SearchCombo>("TMC_Event_Combo", &QComboBox::activated, &TmcBuilder::TMC_Event_Combo_Click, this);
    Label3 = heading("Label3", {205}, TMC_Event_Combo);
    TMC_Event_Hex_Label = named<ValueLabel>("TMC_Event_Hex_Label", this);
    m_book.tip(TMC_Event_Hex_Label, {562, "Eventnummer, hexadezimal"});
    TMC_Loc_Combo = wired<SearchCombo>("TMC_Loc_Combo", &QComboBox::activated, &TmcBuilder::TMC_Loc_Combo_Click, this);
    Label4 = heading("Label4", {206}, TMC_Loc_Combo);
    TMC_Local_Hex_Label = named<ValueLabel>("TMC_Local_Hex_Label", this);
    m_book.tip(TMC_Local_Hex_Label, {563, "Locationnummer, hexadezimal"});
    m_events = new ShownList(this);
    m_book.placeholder(TMC_Event_Combo, {560, "Eventauswahl"});
    m_book.placeholder(TMC_Loc_Combo, {561, "Locationauswahl"});
    TMC_Event_Combo->setModel(m_events);
    m_locations = new ShownList(this);
    TMC_Loc_Combo->setModel(m_locations);
    for (SearchCombo* combo : {TMC_Event_Combo, TMC_Loc_Combo}) {
        combo->setSizeAdjustPolicy(QComboBox::AdjustToMinimumContentsLengthWithIcon);
        combo->setMinimumContentsLength(20);
        combo->nameParts();
        const Caption search{996, "Suchen: Teil des Wortes oder Code"};
        m_book.placeholder(combo->searchBox(), search);
        m_book.spoken(combo->searchBox(), search);
    }
    for (ValueLabel* number : {TMC_Event_Hex_Label, TMC_Local_Hex_Label}) number->makeRoomFor(kHexDigits);
}

void TmcBuilder::createDuration() {
    Frame5 = captioned<QGroupBox>("Frame5", {568, "duration / persistence"}, this);
    const auto weight = [this](const char* name, const Caption& caption, void (TmcBuilder::*handler)()) {
        return captioned<QCheckBox>(name, caption, Frame5, &QCheckBox::toggled, handler);
    };
    TMC_DP1_Check = weight("TMC_DP1_Check", {565, "DP 1"}, &TmcBuilder::TMC_DP1_Check_Click);
    TMC_DP2_Check = weight("TMC_DP2_Check", {566, "DP 2"}, &TmcBuilder::TMC_DP2_Check_Click);
    TMC_DP3Check = weight("TMC_DP3Check", {567, "DP 3"}, &TmcBuilder::TMC_DP3Check_Click);
    // Only the user's choice: the boxes set the combo in turn, and the two would call each other for ever.
    DurationCombo = wired<QComboBox>("DurationCombo", &QComboBox::activated, &TmcBuilder::DurationCombo_Click, Frame5);
    m_book.spokenAs(DurationCombo, Frame5);
}

void TmcBuilder::createCode() {
    TMCInfoOnOff = wired<QPushButton>("TMCInfoOnOff", &QPushButton::clicked, &TmcBuilder::TMCInfoOnOff_Click,
                                      QStringLiteral("<"), this);
    TMCInfoOnOff->setFixedWidth(fontMetrics().horizontalAdvance(QStringLiteral("<")) + 18);
    m_book.describe(TMCInfoOnOff, {572, "Bitanzeige ein / aus"});
    m_bitsHeading = captioned<QLabel>("", {887, "Bits"}, this);
    m_bitsHeading->setBuddy(TMCInfoOnOff);
    m_bits = new BitDisplay(m_book, this);
    connect(m_bits, &BitDisplay::changed, this, &TmcBuilder::TMCGruppe8Maker);

    m_codeHeading = captioned<QLabel>("", {571, "Gruppe 8A"}, this);
    TMC_Gr8_Label = named<ValueLabel>("TMC_Gr8_Label", this);
    QFont font = TMC_Gr8_Label->font();
    font.setFamilies(arialFamilies());
    TMC_Gr8_Label->setFont(font);
    TMC_Gr8_Label->setTextInteractionFlags(Qt::TextSelectableByMouse);
    TMC_Gr8_Label->makeRoomFor(static_cast<int>(kGroupCodeLength) + 1);
}

void TmcBuilder::arrange() {
    auto* lists = grid({{Label3, TMC_Event_Combo, TMC_Event_Hex_Label}, {Label4, TMC_Loc_Combo, TMC_Local_Hex_Label}});
    lists->setColumnStretch(1, 1);

    layOut(TMC_Frame1, column(Tmc_richtung));
    layOut(Frame5, grid({{TMC_DP1_Check, TMC_DP2_Check, TMC_DP3Check}, {{DurationCombo, 3, Qt::AlignLeft}}}));
    auto* extent = column({TMC_Var_Label, {TMC_Var_Combo, 0, Qt::AlignLeft}, kRoom});
    auto* flags = column({TMC_Div, TMC_F_Check, TMC_T_Check});
    auto* fields = row({TMC_Frame1, extent, kRoom, Frame5, kRoom, flags});
    fields->setSpacing(2 * kGap);

    auto* code = grid({{{m_codeHeading, 1, Qt::AlignHCenter}}, {TMC_Gr8_Label}});
    auto* bits = row(
        {{TMCInfoOnOff, 0, Qt::AlignBottom}, {m_bitsHeading, 0, Qt::AlignBottom}, space(kGap), m_bits, kRoom, code});
    layOut(this, column({lists, fields, bits}), 0);
}

void TmcBuilder::label() {
    Page::label();
    TMCGruppe8Maker();
}

void TmcBuilder::load() {
    fillZeroToSeven(TMC_Var_Combo);
    fillZeroToSeven(DurationCombo);
    TMCInfoOnOff->setText(QStringLiteral("<"));
    TMCInfoOnOff_Click();
    TMCGruppe8Maker();
}

void TmcBuilder::reloadLists() {
    takeAllSteps({[this] { reload(TMC_Event_Combo, m_events, kEventList); },
                  [this] { reload(TMC_Loc_Combo, m_locations, kLocationList); }});
}

void TmcBuilder::reload(QComboBox* combo, ShownList* list, const char* fileName) {
    const QString chosen = combo->currentText();
    list->load(m_with, fileName);
    combo->setCurrentIndex(chosen.isEmpty() ? -1 : list->rowOf(chosen));
}

void TmcBuilder::showNumber(const QComboBox* combo, QLabel* hexadecimals, BitDisplay::Field field) {
    const double number = entryNumber(toBytes(combo->currentText()));
    hexadecimals->setText(toText(hexadecimal(number)));
    m_bits->set(field, number);
}

void TmcBuilder::TMC_Var_Combo_Click() {
    m_bits->set(BitDisplay::Extent, leadingNumber(toBytes(TMC_Var_Combo->currentText())));
}

void TmcBuilder::showDuration() {
    const int duration = (TMC_DP1_Check->isChecked() ? 4 : 0) + (TMC_DP2_Check->isChecked() ? 2 : 0) +
                         (TMC_DP3Check->isChecked() ? 1 : 0);
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
    const GroupBits bits = m_bits->message();
    // While fields are not chosen the code lacks bits, and is sent all the same.
    const bool corrected = m_with.state.corrections.trafficFields;
    TMC_Gr8_Label->setText(toText(kdx::groupCode(corrected ? withZeros(bits) : bits)));
    const QStringList missing = corrected ? QStringList() : m_bits->notChosen();
    showWarning(*TMC_Gr8_Label, missing.isEmpty()
                                    ? QString()
                                    : caption({886, "Noch nicht gewählt: %1"}).arg(missing.join(QStringLiteral(", "))));
}

}  // namespace kdx
