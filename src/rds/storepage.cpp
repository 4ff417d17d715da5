#include "rds/storepage.h"

#include <QPushButton>
#include <QVBoxLayout>

#include "coder/sendparam.h"
#include "rds/settings.h"
#include "ui/controls.h"

namespace kdx {

StorePage::StorePage(const PageContext& with, QWidget* parent) : Page(with, parent) {
    create();
    arrange();
}

void StorePage::create() {
    for (std::size_t i = 0; i < Store_Taste.size(); ++i) {
        Store_Taste[i] = element<QPushButton>("Store_Taste", i, this);
        m_book.text(Store_Taste[i], {430, "Speichern --> Dataset", QStringLiteral(" %1").arg(i + 1)});
        connect(Store_Taste[i], &QPushButton::clicked, this, [this, i] { Store_Taste_Click(static_cast<int>(i)); });
    }
}

void StorePage::arrange() {
    auto* column = new QVBoxLayout(this);
    tighten(column, 16);
    column->setSpacing(12);
    column->addStretch();
    for (QPushButton* store : Store_Taste) {
        store->setMinimumSize(240, 32);
        column->addWidget(store, 0, Qt::AlignHCenter);
    }
    column->addStretch();
}

void StorePage::Store_Taste_Click(int index) {
    m_with.params.SendParam(setting::kStore, std::to_string(index + 1));
}

}  // namespace kdx
