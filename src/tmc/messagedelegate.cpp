#include "tmc/messagedelegate.h"

#include "tmc/groupcode.h"
#include "tmc/messagelist.h"

#include <QApplication>
#include <QPainter>
#include <QStyle>

namespace kdx {

namespace {

constexpr int kSide = 3;
constexpr auto kTextLength = static_cast<int>(kMessageTextLength);
constexpr auto kEventAt = static_cast<int>(kMessageTextLength + kAfterLocation.size());

}  // namespace

void MessageDelegate::paint(QPainter* painter, const QStyleOptionViewItem& option, const QModelIndex& index) const {
    QStyleOptionViewItem row = option;
    initStyleOption(&row, index);
    const QString entry = std::exchange(row.text, {});
    const QStyle* style = row.widget != nullptr ? row.widget->style() : QApplication::style();
    style->drawControl(QStyle::CE_ItemViewItem, &row, painter, row.widget);

    const QRect room = row.rect.adjusted(kSide, 0, -kSide, 0);
    const QString code = entry.right(static_cast<int>(kGroupCodeLength));
    const int codeWidth = row.fontMetrics.horizontalAdvance(QStringLiteral("DDDDDDDDDD"));  // the widest digits
    const int textWidth = (room.width() - codeWidth - 4 * kSide) / 2;
    const auto role = (row.state & QStyle::State_Selected) != 0 ? QPalette::HighlightedText : QPalette::Text;
    const auto draw = [&](int left, int width, const QString& text) {
        const QRect column(room.left() + left, room.top(), width, room.height());
        style->drawItemText(painter, column, Qt::AlignVCenter | Qt::AlignLeft, row.palette, true,
                            row.fontMetrics.elidedText(text, Qt::ElideRight, width), role);
    };
    draw(0, textWidth, entry.left(kTextLength).trimmed());
    draw(textWidth + 2 * kSide, textWidth, entry.mid(kEventAt, kTextLength).trimmed());
    draw(room.width() - codeWidth, codeWidth, code);
}

QSize MessageDelegate::sizeHint(const QStyleOptionViewItem& option, const QModelIndex& index) const {
    return {0, QStyledItemDelegate::sizeHint(option, index).height()};
}

}  // namespace kdx
