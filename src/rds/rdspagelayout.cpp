// What the page "R D S" is made of, in the order in which the tab key walks it, and where it stands.
#include <QCheckBox>
#include <QComboBox>
#include <QGroupBox>
#include <QIcon>
#include <QLineEdit>
#include <QPushButton>

#include "rds/dynamicps.h"
#include "rds/programme.h"
#include "rds/rdspage.h"
#include "rds/taframe.h"
#include "ui/clickablelabel.h"
#include "ui/pictureswitch.h"
#include "ui/text.h"
#include "ui/ticker.h"

namespace kdx {

RdsPage::RdsPage(const PageContext& with, Programme& programme, QWidget* parent)
    : Page(with, parent), m_programme(programme) {
    create();
    arrange();
}

void RdsPage::create() {
    createService();

    Check1 = captioned<QCheckBox>("Check1", {380, "TP on/off"}, this);
    connect(Check1, &QCheckBox::clicked, this, &RdsPage::Check1_Click);
    m_ta = new TaFrame(m_with, m_programme, this);
    connect(m_ta, &TaFrame::optionChosen, m_dynamicPs, &DynamicPs::stopQuietly);

    Image1 = named<QLabel>("Image1", this);
    Image1->setPixmap(QIcon(QStringLiteral(":/kdx-rds-64.png")).pixmap(QSize(40, 40), devicePixelRatioF()));

    MS_Frame = captioned<QGroupBox>("MS_Frame", {55}, this);
    MS_opt.create("MS_opt", MS_Frame);
    MS_opt.onClick(this, &RdsPage::MS_opt_Click);
    m_book.text(MS_opt[0], {56});
    m_book.text(MS_opt[1], {57});

    Time_Frame = captioned<QGroupBox>("Time_Frame", {54}, this);
    Zeit_Taste = named<PictureSwitch>("Zeit_Taste", m_with.data, Time_Frame);
    m_book.spokenAs(Zeit_Taste, Time_Frame);
    connect(Zeit_Taste, &PictureSwitch::clicked, this, &RdsPage::Zeit_Taste_Click);
    Uhr_Zeit = named<ClickableLabel>("Uhr_Zeit", Time_Frame);
    Uhr_Zeit->setAlignment(Qt::AlignCenter);
    connect(Uhr_Zeit, &ClickableLabel::doubleClicked, this, &RdsPage::Uhr_Zeit_DblClick);
    Timer1 = named<Ticker>("Timer1", m_with.tickers, this);
    Timer1->setPeriod(999);
    Timer1->setEnabled(true);
    connect(Timer1, &QTimer::timeout, this, &RdsPage::Timer1_Timer);

    DI_Frame = captioned<QGroupBox>("DI_Frame", {396, "Decoder Info"}, this);
    DI_Opt.create("DI_Opt", DI_Frame);
    DI_Opt.onClick(this, &RdsPage::DI_Opt_Click);
    for (int i = 0; i < 8; ++i) m_book.text(DI_Opt[static_cast<std::size_t>(i)], {59 + i});
    for (std::size_t i = 8; i < DI_Opt.size(); ++i) DI_Opt[i]->setText(QString::number(i));  // have no name

    RT_Frame = captioned<QGroupBox>("RT_Frame", {49}, this);
    RT_Text1 = named<QLineEdit>("RT_Text1", RT_Frame);
    m_book.spokenAs(RT_Text1, RT_Frame);
    connect(RT_Text1, &QLineEdit::textChanged, this, &RdsPage::RT_Text1_Change);
    RT_Taste1 = sendButton("RT_Taste1", " RT", RT_Text1, RT_Frame);
    connect(RT_Taste1, &QPushButton::clicked, this, &RdsPage::RT_Taste1_Click);
    RT_clear1 = captioned<QPushButton>("RT_clear1", {52}, RT_Frame);
    connect(RT_clear1, &QPushButton::clicked, this, &RdsPage::RT_clear1_Click);
}

void RdsPage::createService() {
    PS_Label = captioned<QLabel>("PS_Label", {393, "PS"}, this);
    PS_T = named<QLineEdit>("PS_T", this);
    PS_Label->setBuddy(PS_T);
    PS_Taste = sendButton("PS_Taste", " PS", PS_T, this);
    connect(PS_Taste, &QPushButton::clicked, this, &RdsPage::PS_Taste_Click);

    PI_Label = captioned<QLabel>("PI_Label", {394, "PI"}, this);
    PI_T = named<QLineEdit>("PI_T", this);
    PI_Label->setBuddy(PI_T);
    connect(PI_T, &QLineEdit::textChanged, this, &RdsPage::PI_T_Change);
    Command3 = sendButton("Command3", " PI", PI_T, this);
    connect(Command3, &QPushButton::clicked, this, &RdsPage::Command3_Click);

    Label1 = captioned<QLabel>("Label1", {395, "PTY"}, this);
    PTY_Combo1 = named<QComboBox>("PTY_Combo1", this);
    Label1->setBuddy(PTY_Combo1);
    connect(PTY_Combo1, &QComboBox::activated, this, &RdsPage::PTY_Combo1_Click);

    m_dynamicPs = new DynamicPs(
        m_with, m_programme, [this] { return toBytes(PS_T->text()); }, m_book, this);
}

QPushButton* RdsPage::sendButton(const char* name, const char* what, QLineEdit* entry, QWidget* parent) {
    constexpr int kSend = 53;
    auto* button = captioned<QPushButton>(name, {kSend}, parent);
    m_book.spoken(button, {kSend, "", QString::fromLatin1(what)});
    connect(entry, &QLineEdit::returnPressed, button, &QPushButton::click);
    return button;
}

void RdsPage::arrange() {
    auto* service = new QGridLayout;
    service->setSpacing(kGap);
    service->addWidget(PS_Label, 0, 0);
    service->addWidget(PS_T, 0, 1);
    service->addWidget(PS_Taste, 0, 2);
    service->addWidget(PI_Label, 1, 0);
    service->addWidget(PI_T, 1, 1);
    service->addWidget(Command3, 1, 2);
    service->addWidget(Label1, 2, 0);
    service->addWidget(PTY_Combo1, 2, 1, 1, 2);
    service->addWidget(m_dynamicPs->PS_A_Label, 3, 0);
    auto* dynamic = new QHBoxLayout;
    dynamic->setSpacing(kGap);
    dynamic->addWidget(m_dynamicPs->Taste_PS_Auto);
    dynamic->addWidget(m_dynamicPs->PS_dyn_Check);
    dynamic->addStretch();
    service->addLayout(dynamic, 3, 1);
    service->addWidget(Check1, 3, 2);
    service->setColumnStretch(1, 1);

    auto* musicSpeech = new QHBoxLayout(MS_Frame);
    tighten(musicSpeech);
    for (QRadioButton* option : MS_opt) musicSpeech->addWidget(option);

    auto* time = new QHBoxLayout(Time_Frame);
    tighten(time);
    time->addWidget(Zeit_Taste);
    time->addWidget(Uhr_Zeit, 1);

    auto* decoder = new QGridLayout(DI_Frame);
    tighten(decoder);
    decoder->setHorizontalSpacing(8);
    decoder->setVerticalSpacing(1);
    for (int i = 0; i < 16; ++i) decoder->addWidget(DI_Opt[static_cast<std::size_t>(i)], i % 8, i / 8);
    decoder->setColumnStretch(0, 2);
    decoder->setColumnStretch(1, 1);

    auto* radiotext = new QHBoxLayout(RT_Frame);
    tighten(radiotext);
    radiotext->addWidget(RT_Text1, 1);
    radiotext->addWidget(RT_Taste1);
    radiotext->addWidget(RT_clear1);

    auto* small = new QHBoxLayout;
    small->setSpacing(kGap);
    small->addWidget(MS_Frame);
    small->addWidget(Time_Frame, 1);
    small->addWidget(Image1, 0, Qt::AlignCenter);

    auto* left = new QVBoxLayout;
    left->setSpacing(kGap);
    left->addLayout(service);
    left->addWidget(m_ta, 1);
    auto* right = new QVBoxLayout;
    right->setSpacing(kGap);
    right->addLayout(small);
    right->addWidget(DI_Frame, 1);

    auto* columns = new QHBoxLayout;
    columns->setSpacing(8);
    columns->addLayout(left, 1);
    columns->addLayout(right, 1);
    auto* page = new QVBoxLayout(this);
    tighten(page, kPageMargin);
    page->addLayout(columns, 1);
    page->addWidget(RT_Frame);
}

}  // namespace kdx
