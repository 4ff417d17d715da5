#pragma once

#include <QGroupBox>

#include "ui/caption.h"
#include "ui/pagecontext.h"

class QTableWidget;

namespace kdx {

namespace air {
class Shadow;
}

/// The types of groups that go out: the latest group of each, and its share as a bar.
class GroupMonitor : public QGroupBox {
public:
    GroupMonitor(const PageContext& with, QWidget* parent);

    void label();
    void show(const air::Shadow& shadow);
    [[nodiscard]] QString text() const;

private:
    void showCell(int row, int column, const QString& text);

    PageContext m_with;
    CaptionBook m_book;
    QTableWidget* Air_Gruppen = nullptr;
};

}  // namespace kdx
