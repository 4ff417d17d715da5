// What the page "R D S" is made of, in the order in which the tab key walks it, and where it stands.
#include <QIcon>

#include "rds/dynamicps.h"
#include "rds/rdspage.h"
#include "rds/settings.h"
#include "rds/taframe.h"
#include "settings/withoutcontrols.h"
#include "ui/entrycounter.h"
#include "ui/keymarks.h"
#include "ui/layouts.h"

namespace kdx {

RdsPage::RdsPage(const PageContext& with, Programme& programme, QWidget* parent)
    : Page(with, parent),
      m_programme(programme),
      m_sentMusicSpeech(with, setting::kMusicSpeech.sendKey),
      m_sentPty(with, setting::kPty.sendKey) {
    create();
    arrange();
    KeyMarks& marks = m_with.marks;
    marks.add(setting::kPty.sendKey, PTY_Combo1);
    marks.add(setting::kTrafficProgramme, Check1);
    marks.watch(setting::kTrafficProgramme, this, [this](const Judgement&) {
        if (m_shownTrafficProgramme) showTrafficProgramme(*m_shownTrafficProgramme);
    });
    marks.add(setting::kMusicSpeech.sendKey, MS_opt);
    marks.add(setting::kDecoderInfo.sendKey, DI_Opt);
    marks.add(setting::kClock, Uhr_Zeit);
}

void RdsPage::create() {
    createService();

    Check1 = clicked<QCheckBox>("Check1", {380, "TP on/off"}, this, &RdsPage::Check1_Click);
    m_ta = new TaFrame(m_with, m_programme, this);
    connect(m_ta, &TaFrame::optionChosen, m_dynamicPs, &DynamicPs::stopQuietly);

    Image1 = named<QLabel>("Image1", this);
    Image1->setPixmap(QIcon(QPixmap(QStringLiteral(":/kdx-rds-64.png"))).pixmap(QSize(40, 40), devicePixelRatioF()));

    MS_Frame = captioned<QGroupBox>("MS_Frame", {55}, this);
    createOptions(MS_opt, "MS_opt", {{56}, {57}}, MS_Frame, &RdsPage::MS_opt_Click);

    Time_Frame = captioned<QGroupBox>("Time_Frame", {54}, this);
    Zeit_Taste = wired<PictureSwitch>("Zeit_Taste", &PictureSwitch::clicked, &RdsPage::Zeit_Taste_Click, m_with.data,
                                      Time_Frame);
    m_book.spokenAs(Zeit_Taste, Time_Frame);
    Uhr_Zeit =
        wired<ClickableLabel>("Uhr_Zeit", &ClickableLabel::doubleClicked, &RdsPage::Uhr_Zeit_DblClick, Time_Frame);
    Uhr_Zeit->setAlignment(Qt::AlignCenter);
    Timer1 = timer("Timer1", 999, &RdsPage::Timer1_Timer);
    Timer1->setEnabled(true);

    DI_Frame = captioned<QGroupBox>("DI_Frame", {396, "Decoder Info"}, this);
    DI_Opt.create("DI_Opt", DI_Frame);
    DI_Opt.onClick(this, &RdsPage::DI_Opt_Click);
    for (int i = 0; i < 8; ++i) m_book.text(DI_Opt[static_cast<std::size_t>(i)], {59 + i});
    for (std::size_t i = 8; i < DI_Opt.size(); ++i) DI_Opt[i]->setText(QString::number(i));  // have no name

    RT_Frame = captioned<QGroupBox>("RT_Frame", {49}, this);
    RT_Text1 = wired<SentEntry>("RT_Text1", &QLineEdit::textChanged, &RdsPage::RT_Text1_Change, m_with,
                                setting::kRadiotext.sendKey, RT_Frame);
    m_book.spokenAs(RT_Text1, RT_Frame);
    RT_Zaehler =
        named<EntryCounter>("RT_Zaehler", m_with, setting::kRadiotext.sendKey, kRadiotextLength, RT_Text1, RT_Frame);
    RT_Taste1 = sendButton("RT_Taste1", " RT", RT_Text1, &RdsPage::RT_Taste1_Click);
    RT_clear1 = clicked<QPushButton>("RT_clear1", {52}, RT_Frame, &RdsPage::RT_clear1_Click);
}

void RdsPage::createService() {
    PS_T = named<SentEntry>("PS_T", m_with, setting::kPs.sendKey, this);
    connect(PS_T, &QLineEdit::textChanged, this,
            [this](const QString& text) { m_programme.psField = withoutControls(toBytes(text)); });
    PS_Label = heading("PS_Label", {393, "PS"}, PS_T);
    PS_Zaehler = named<EntryCounter>("PS_Zaehler", m_with, setting::kPs.sendKey, kPsLength, PS_T, this);
    PS_Taste = sendButton("PS_Taste", " PS", PS_T, &RdsPage::PS_Taste_Click);
    PI_T = wired<SentEntry>("PI_T", &QLineEdit::textChanged, &RdsPage::PI_T_Change, m_with, setting::kPi.sendKey, this);
    PI_Label = heading("PI_Label", {394, "PI"}, PI_T);
    PI_Zaehler = named<EntryCounter>("PI_Zaehler", m_with, setting::kPi.sendKey, kPiLength, PI_T, this);
    Command3 = sendButton("Command3", " PI", PI_T, &RdsPage::Command3_Click);
    PTY_Combo1 = wired<QComboBox>("PTY_Combo1", &QComboBox::activated, &RdsPage::PTY_Combo1_Click, this);
    Label1 = heading("Label1", {395, "PTY"}, PTY_Combo1);
    m_dynamicPs = new DynamicPs(
        m_with, m_programme, [this] { return toBytes(PS_T->text()); }, this);
    connect(m_dynamicPs, &DynamicPs::typedPsSent, this, [this] {
        PS_T->wentOut(toBytes(PS_T->text()));
        showValue(StatusSlot::Ps, PS_T, toBytes(PS_T->text()));
    });
}

QPushButton* RdsPage::sendButton(const char* name, const char* what, SentEntry* entry, void (RdsPage::*handler)()) {
    constexpr int kSend = 53;
    auto* button = clicked<QPushButton>(name, {kSend}, entry->parentWidget(), handler);
    m_book.spoken(button, {kSend, "", QString::fromLatin1(what)});
    connect(entry, &QLineEdit::returnPressed, button, &QPushButton::click);
    return button;
}

void RdsPage::arrange() {
    auto* dynamic = row({m_dynamicPs->Taste_PS_Auto, m_dynamicPs->PS_dyn_Check, kRoom});
    auto* service = grid({{PS_Label, row({{PS_T, 1}, PS_Zaehler}), PS_Taste},
                          {PI_Label, row({{PI_T, 1}, PI_Zaehler}), Command3},
                          {Label1, {PTY_Combo1, 2}},
                          {m_dynamicPs->PS_A_Label, dynamic, Check1}});
    service->setColumnStretch(1, 1);

    layOut(MS_Frame, row(MS_opt));
    layOut(Time_Frame, row({Zeit_Taste, {Uhr_Zeit, 1}}));
    layOut(RT_Frame, row({{RT_Text1, 1}, RT_Zaehler, RT_Taste1, RT_clear1}));

    auto* decoder = grid({});
    decoder->setHorizontalSpacing(8);
    decoder->setVerticalSpacing(1);
    for (int i = 0; i < 16; ++i) decoder->addWidget(DI_Opt[static_cast<std::size_t>(i)], i % 8, i / 8);
    decoder->setColumnStretch(0, 2);
    decoder->setColumnStretch(1, 1);
    layOut(DI_Frame, decoder);

    auto* small = row({MS_Frame, {Time_Frame, 1}, {Image1, 0, Qt::AlignCenter}});
    auto* columns = row({{column({service, {m_ta, 1}}), 1}, {column({small, {DI_Frame, 1}}), 1}});
    columns->setSpacing(8);
    layOut(this, column({{columns, 1}, RT_Frame}), kPageMargin);
}

}  // namespace kdx
