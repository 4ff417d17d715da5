#include "rds/storepage.h"

#include <QPushButton>
#include <QVBoxLayout>

#include "coder/sendparam.h"
#include "settings/captions.h"
#include "ui/controls.h"
#include "ui/text.h"

namespace kdx {

StorePage::StorePage(const PageContext& with, QWidget* parent) : QWidget(parent), m_with(with) {
    auto* column = new QVBoxLayout(this);
    tighten(column, 16);
    column->setSpacing(12);
    column->addStretch();
    for (std::size_t i = 0; i < Store_Taste.size(); ++i) {
        Store_Taste[i] = element<QPushButton>("Store_Taste", i, this);
        Store_Taste[i]->setMinimumSize(240, 32);
        connect(Store_Taste[i], &QPushButton::clicked, this, [this, i] { Store_Taste_Click(static_cast<int>(i)); });
        column->addWidget(Store_Taste[i], 0, Qt::AlignHCenter);
    }
    column->addStretch();
}

void StorePage::label() {
    for (std::size_t i = 0; i < Store_Taste.size(); ++i) {
        Store_Taste[i]->setText(
            toText(m_with.captions.own(430, "Speichern --> Dataset") + " " + std::to_string(i + 1)));
    }
}

void StorePage::Store_Taste_Click(int index) {
    m_with.params.SendParam("STORE", std::to_string(index + 1));
}

}  // namespace kdx
