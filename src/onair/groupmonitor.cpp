#include "onair/groupmonitor.h"

#include <QHeaderView>
#include <QPainter>
#include <QStyledItemDelegate>
#include <QTableWidget>

#include <array>

#include "air/groupbudget.h"
#include "air/shadow.h"
#include "base/numbers.h"
#include "onair/tables.h"
#include "ui/layouts.h"

namespace kdx {

namespace {

enum Column { Type, Blocks, Share, ColumnCount };
constexpr int kPercent = Qt::UserRole;

// Each has its row for good, so that none jumps when another comes.
constexpr std::array kTypes = {air::GroupType::Basic0A,     air::GroupType::Basic0B,     air::GroupType::Radiotext2A,
                               air::GroupType::Radiotext2B, air::GroupType::OpenData3A,  air::GroupType::Clock4A,
                               air::GroupType::Traffic8A,   air::GroupType::Networks14A, air::GroupType::Networks14B,
                               air::GroupType::Tuning15B};

/// Draws a share as a bar with its number on it.
class BarDelegate final : public QStyledItemDelegate {
public:
    using QStyledItemDelegate::QStyledItemDelegate;

    void paint(QPainter* painter, const QStyleOptionViewItem& option, const QModelIndex& index) const override {
        const int percent = index.data(kPercent).toInt();
        const QRect room = option.rect.adjusted(2, 2, -4, -2);
        QRect bar = room;
        bar.setWidth(room.width() * percent / 100);
        painter->fillRect(room, option.palette.color(QPalette::AlternateBase));
        QColor colour = option.palette.color(QPalette::Highlight);
        colour.setAlpha(110);
        painter->fillRect(bar, colour);
        painter->setPen(option.palette.color(QPalette::Text));
        painter->drawText(room.adjusted(4, 0, -4, 0), Qt::AlignVCenter | Qt::AlignRight, index.data().toString());
    }
};

QString blocksOf(const air::Group& group) {
    QStringList words;
    for (const std::uint16_t block : group.blocks) words += QString::fromStdString(hexDigits(block, 4));
    return words.join(QLatin1Char(' '));
}

}  // namespace

GroupMonitor::GroupMonitor(const PageContext& with, QWidget* parent) : QGroupBox(parent), m_with(with) {
    m_book.text(this, {751, "Gruppen"});
    Air_Gruppen = newTable("Air_Gruppen", ColumnCount, Share, this);
    Air_Gruppen->setItemDelegateForColumn(Share, new BarDelegate(Air_Gruppen));
    m_book.spokenAs(Air_Gruppen, this);
    // The width of a group does not follow what happens to be in it.
    QFont fixed = font();
    fixed.setFamilies({QStringLiteral("Courier New"), QStringLiteral("Liberation Mono")});
    Air_Gruppen->horizontalHeader()->setSectionResizeMode(Blocks, QHeaderView::Fixed);
    Air_Gruppen->setColumnWidth(Blocks,
                                QFontMetrics(fixed).horizontalAdvance(QStringLiteral("0000 0000 0000 0000 ")) + 8);
    Air_Gruppen->setRowCount(static_cast<int>(kTypes.size()));
    for (int row = 0; row < Air_Gruppen->rowCount(); ++row) {
        for (int column = 0; column < ColumnCount; ++column) {
            auto* item = new QTableWidgetItem;
            item->setFlags(Qt::ItemIsEnabled | Qt::ItemIsSelectable);
            Air_Gruppen->setItem(row, column, item);
        }
        Air_Gruppen->item(row, Blocks)->setFont(fixed);
        Air_Gruppen->item(row, Type)->setText(
            QString::fromStdString(air::nameOf(kTypes.at(static_cast<std::size_t>(row)))));
    }
    Air_Gruppen->resizeRowsToContents();
    Air_Gruppen->setMinimumHeight(Air_Gruppen->verticalHeader()->length() +
                                  Air_Gruppen->horizontalHeader()->sizeHint().height() + 4);
    layOut(this, column({{Air_Gruppen, 1}}), 2);
}

void GroupMonitor::label() {
    m_book.label(m_with.captions);
    Air_Gruppen->setHorizontalHeaderLabels({captionText(m_with.captions, {752, "Typ"}),
                                            captionText(m_with.captions, {753, "Zuletzt"}),
                                            captionText(m_with.captions, {754, "Anteil"})});
}

void GroupMonitor::show(const air::Shadow& shadow) {
    const auto& latest = shadow.sent();
    const bool goesOut = !latest.empty() && latest.back().what.kind == air::OnAir::Kind::Group;
    std::size_t all = 0;
    for (const auto& [type, groups] : shadow.types()) all += groups.count;
    for (int row = 0; row < Air_Gruppen->rowCount(); ++row) {
        const auto found = shadow.types().find(kTypes.at(static_cast<std::size_t>(row)));
        const bool isSent = goesOut && found != shadow.types().end();
        const int percent = isSent && all > 0 ? static_cast<int>((200 * found->second.count / all + 1) / 2) : 0;
        showCell(row, Blocks, isSent ? blocksOf(found->second.latest) : QString());
        QTableWidgetItem* share = Air_Gruppen->item(row, Share);
        if (share->data(kPercent).toInt() != percent) share->setData(kPercent, percent);
        showCell(row, Share, isSent ? QStringLiteral("%1 %").arg(percent) : QString());
    }
}

void GroupMonitor::showCell(int row, int column, const QString& text) {
    QTableWidgetItem* item = Air_Gruppen->item(row, column);
    if (item->text() != text) item->setText(text);
}

QString GroupMonitor::text() const {
    return textOf(Air_Gruppen);
}

}  // namespace kdx
