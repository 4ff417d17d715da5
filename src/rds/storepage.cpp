#include "rds/storepage.h"

#include "coder/sendparam.h"
#include "rds/settings.h"
#include "ui/layouts.h"

namespace kdx {

StorePage::StorePage(const PageContext& with, QWidget* parent) : Page(with, parent) {
    auto* buttons = column({kRoom});
    buttons->setSpacing(12);
    for (std::size_t i = 0; i < Store_Taste.size(); ++i) {
        Store_Taste[i] = element<QPushButton>("Store_Taste", i, this);
        Store_Taste[i]->setMinimumSize(240, 32);
        m_book.text(Store_Taste[i], {430, "Speichern --> Dataset", QStringLiteral(" %1").arg(i + 1)});
        connect(Store_Taste[i], &QPushButton::clicked, this, [this, i] { Store_Taste_Click(static_cast<int>(i)); });
        add(buttons, {{Store_Taste[i], 0, Qt::AlignHCenter}});
    }
    layOut(this, add(buttons, {kRoom}), 16);
}

void StorePage::Store_Taste_Click(int index) {
    m_with.params.SendParam(setting::kStore, std::to_string(index + 1));
}

}  // namespace kdx
