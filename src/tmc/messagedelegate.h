#pragma once

#include <QStyledItemDelegate>

namespace kdx {

/// Shows an entry of the message list in three columns (location, event, group code), so that the code is always to be
/// seen; the entry itself stays one text.
class MessageDelegate : public QStyledItemDelegate {
public:
    using QStyledItemDelegate::QStyledItemDelegate;

    void paint(QPainter* painter, const QStyleOptionViewItem& option, const QModelIndex& index) const override;
    [[nodiscard]] QSize sizeHint(const QStyleOptionViewItem& option, const QModelIndex& index) const override;
};

}  // namespace kdx
