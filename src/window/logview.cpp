#include "window/logview.h"

#include <QClipboard>
#include <QGuiApplication>
#include <QHeaderView>
#include <QLineEdit>
#include <QPushButton>
#include <QScrollBar>
#include <QShortcut>
#include <QSortFilterProxyModel>
#include <QTableView>

#include <algorithm>

#include "settings/captions.h"
#include "ui/layouts.h"
#include "ui/named.h"
#include "ui/text.h"
#include "window/trafficlog.h"

namespace kdx {

LogView::LogView(TrafficLog& log, const Captions& captions, QWidget* parent) : QDialog(parent), m_log(log) {
    setObjectName(QStringLiteral("LogView"));
    m_filter = named<QLineEdit>("LogFilter", this);
    m_filter->setClearButtonEnabled(true);
    m_filtered = new QSortFilterProxyModel(this);
    m_filtered->setSourceModel(&log);
    m_filtered->setFilterKeyColumn(-1);
    m_filtered->setFilterCaseSensitivity(Qt::CaseInsensitive);
    connect(m_filter, &QLineEdit::textChanged, m_filtered, &QSortFilterProxyModel::setFilterFixedString);

    m_table = named<QTableView>("LogTable", this);
    m_table->setModel(m_filtered);
    QFont fixed = font();
    fixed.setFamilies({QStringLiteral("Courier New"), QStringLiteral("Liberation Mono")});  // keys stay aligned
    m_table->setFont(fixed);
    m_table->setSelectionBehavior(QAbstractItemView::SelectRows);
    m_table->setShowGrid(false);
    m_table->setWordWrap(false);
    m_table->verticalHeader()->hide();
    m_table->verticalHeader()->setDefaultSectionSize(fontMetrics().height() + 2);
    m_table->verticalHeader()->setSectionResizeMode(QHeaderView::Fixed);
    m_table->horizontalHeader()->setSectionResizeMode(TrafficLog::Text, QHeaderView::Stretch);
    const int letter = m_table->fontMetrics().horizontalAdvance(QLatin1Char('0'));
    m_table->setColumnWidth(TrafficLog::Time, letter * 14);
    m_table->setColumnWidth(TrafficLog::Direction, letter * 10);
    m_table->setColumnWidth(TrafficLog::Status, letter * 13);
    connect(m_filtered, &QAbstractItemModel::rowsInserted, this, &LogView::followEnd);

    m_copy = named<QPushButton>("LogCopy", this);
    connect(m_copy, &QPushButton::clicked, this, &LogView::copy);
    const auto* copyKey = new QShortcut(QKeySequence::Copy, m_table);
    connect(copyKey, &QShortcut::activated, this, &LogView::copy);
    m_clear = named<QPushButton>("LogClear", this);
    connect(m_clear, &QPushButton::clicked, &log, &TrafficLog::clear);
    m_close = named<QPushButton>("LogClose", this);
    connect(m_close, &QPushButton::clicked, this, &QDialog::close);
    for (QPushButton* button : {m_copy, m_clear, m_close}) button->setAutoDefault(false);

    layOut(this, column({{m_table, 1}, row({{m_filter, 1}, m_copy, m_clear, m_close})}), 6);
    resize(700, 360);
    label(captions);
}

void LogView::label(const Captions& captions) {
    setWindowTitle(toText(captions.own(680, "Log")));
    m_filter->setPlaceholderText(toText(captions.own(685, "Filter")));
    m_filter->setAccessibleName(m_filter->placeholderText());
    m_table->setAccessibleName(windowTitle());
    m_copy->setText(toText(captions.own(686, "&Kopieren")));
    m_clear->setText(toText(captions.own(687, "&Leeren")));
    m_close->setText(toText(captions.own(688, "&Schließen")));
}

void LogView::copy() {
    QList<int> rows;
    for (const QModelIndex& index : m_table->selectionModel()->selectedRows()) rows << index.row();
    if (rows.isEmpty()) {
        for (int row = 0; row < m_filtered->rowCount(); ++row) rows << row;  // nothing selected: all that is shown
    }
    std::sort(rows.begin(), rows.end());
    QString text;
    for (const int row : rows) {
        text += m_log.line(m_filtered->mapToSource(m_filtered->index(row, 0)).row()) + QLatin1Char('\n');
    }
    QGuiApplication::clipboard()->setText(text);
}

void LogView::showEvent(QShowEvent* event) {
    QDialog::showEvent(event);
    m_table->scrollToBottom();
}

void LogView::followEnd() {
    // Only while the user looks at the end: reading further up must not be disturbed.
    const QScrollBar* bar = m_table->verticalScrollBar();
    if (bar->value() >= bar->maximum() - 1) m_table->scrollToBottom();
}

}  // namespace kdx
