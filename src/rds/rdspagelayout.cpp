// Where the controls of the page "R D S" stand.
#include <QCheckBox>
#include <QComboBox>
#include <QGroupBox>
#include <QLineEdit>
#include <QPushButton>

#include "rds/dynamicps.h"
#include "rds/rdspage.h"
#include "rds/taframe.h"
#include "ui/clickablelabel.h"
#include "ui/pictureswitch.h"

namespace kdx {

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
