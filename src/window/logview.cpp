#include "window/logview.h"

#include <QClipboard>
#include <QGuiApplication>
#include <QHeaderView>
#include <QLineEdit>
#include <QPushButton>
#include <QScrollBar>
#include <QShortcut>
#include <QSortFilterProxyModel>
#include <QStyledItemDelegate>
#include <QTableView>

#include <algorithm>
#include <utility>

#include "ui/caption.h"
#include "ui/layouts.h"
#include "ui/named.h"
#include "ui/savefile.h"
#include "window/trafficlog.h"

namespace kdx {

namespace {

/// Lets a text be wrapped behind its commas too: lists of frequencies and groups have no blanks.
class WrappingDelegate final : public QStyledItemDelegate {
public:
    using QStyledItemDelegate::QStyledItemDelegate;
    [[nodiscard]] QString displayText(const QVariant& value, const QLocale& locale) const override {
        const QString text = QStyledItemDelegate::displayText(value, locale);
        return QString(text).replace(QLatin1Char(','), QStringLiteral(",\u200B"));
    }
};

}  // namespace

LogView::LogView(TrafficLog& log, const PageContext& with, QWidget* parent)
    : QDialog(parent), m_log(log), m_with(with) {
    setObjectName(QStringLiteral("LogView"));
    Log_Filter = named<QLineEdit>("Log_Filter", this);
    Log_Filter->setClearButtonEnabled(true);
    m_filtered = new QSortFilterProxyModel(this);
    m_filtered->setSourceModel(&log);
    m_filtered->setFilterKeyColumn(-1);
    m_filtered->setFilterCaseSensitivity(Qt::CaseInsensitive);
    connect(Log_Filter, &QLineEdit::textChanged, m_filtered, &QSortFilterProxyModel::setFilterFixedString);

    Log_Liste = named<QTableView>("Log_Liste", this);
    Log_Liste->setModel(m_filtered);
    Log_Liste->setItemDelegateForColumn(TrafficLog::Text, new WrappingDelegate(this));
    QFont fixed = font();
    fixed.setFamilies({QStringLiteral("Courier New"), QStringLiteral("Liberation Mono")});  // keys stay aligned
    Log_Liste->setFont(fixed);
    Log_Liste->setSelectionBehavior(QAbstractItemView::SelectRows);
    Log_Liste->setShowGrid(false);
    Log_Liste->setWordWrap(false);
    Log_Liste->setVerticalScrollMode(QAbstractItemView::ScrollPerPixel);
    Log_Liste->verticalHeader()->hide();
    Log_Liste->verticalHeader()->setDefaultSectionSize(fontMetrics().height() + 2);
    Log_Liste->verticalHeader()->setSectionResizeMode(QHeaderView::Fixed);
    Log_Liste->horizontalHeader()->setSectionResizeMode(TrafficLog::Text, QHeaderView::Stretch);
    const int letter = Log_Liste->fontMetrics().horizontalAdvance(QLatin1Char('0'));
    Log_Liste->setColumnWidth(TrafficLog::Time, letter * 14);
    Log_Liste->setColumnWidth(TrafficLog::Direction, letter * 10);
    Log_Liste->setColumnWidth(TrafficLog::Status, letter * 16);
    connect(m_filtered, &QAbstractItemModel::rowsInserted, this,
            [this](const QModelIndex&, int first, int last) { fit(first, last); });
    // The end stays in view until the user looks further up.
    QScrollBar* bar = Log_Liste->verticalScrollBar();
    connect(bar, &QScrollBar::rangeChanged, this, [this, bar] {
        if (m_follows) bar->setValue(bar->maximum());
    });
    connect(bar, &QScrollBar::valueChanged, this,
            [this, bar] { m_follows = bar->value() >= bar->maximum() - bar->singleStep(); });
    // What is wrapped needs other heights when its column gets another width.
    connect(Log_Liste->horizontalHeader(), &QHeaderView::sectionResized, this,
            [this] { fit(0, m_filtered->rowCount() - 1); });

    const auto button = [this](const char* name, auto signal, auto* receiver, auto handler) {
        auto* made = named<QPushButton>(name, this);
        made->setAutoDefault(false);
        connect(made, signal, receiver, handler);
        return made;
    };
    Log_Pause = button("Log_Pause", &QPushButton::toggled, &log, &TrafficLog::setHeld);
    Log_Umbruch = button("Log_Umbruch", &QPushButton::toggled, this, &LogView::Log_Umbruch_Click);
    for (QPushButton* sticky : {Log_Pause, Log_Umbruch}) sticky->setCheckable(true);
    Log_Sichern = button("Log_Sichern", &QPushButton::clicked, this, &LogView::Log_Sichern_Click);
    m_copy = button("LogCopy", &QPushButton::clicked, this, &LogView::copy);
    const auto* copyKey = new QShortcut(QKeySequence::Copy, Log_Liste);
    connect(copyKey, &QShortcut::activated, this, &LogView::copy);
    m_clear = button("LogClear", &QPushButton::clicked, &log, &TrafficLog::clear);
    m_close = button("LogClose", &QPushButton::clicked, this, &QDialog::close);

    layOut(
        this,
        column({{Log_Liste, 1}, row({{Log_Filter, 1}, Log_Pause, Log_Umbruch, Log_Sichern, m_copy, m_clear, m_close})}),
        6);
    resize(letter * 110, fontMetrics().height() * 26);
    label();
}

LogView::~LogView() {
    // The list and its scroll bar change once more as they go, when there is no view any more.
    for (const QObject* child : findChildren<QObject*>()) child->disconnect(this);
}

void LogView::label() {
    const auto text = [this](const Caption& caption) { return captionText(m_with.captions, caption); };
    setWindowTitle(text({680, "Log"}));
    Log_Filter->setPlaceholderText(text({685, "Filter"}));
    Log_Filter->setAccessibleName(Log_Filter->placeholderText());
    Log_Liste->setAccessibleName(windowTitle());
    Log_Pause->setText(text({977, "&Pause"}));
    Log_Umbruch->setText(text({997, "&Umbruch"}));
    Log_Sichern->setText(text({973, "S&ichern..."}));
    m_copy->setText(text({686, "&Kopieren"}));
    m_clear->setText(text({687, "&Leeren"}));
    m_close->setText(text({688, "&Schließen"}));
    const std::pair<QWidget*, Caption> tips[] = {
        {Log_Filter, {1128, "Zeigt nur Zeilen mit diesem Text; groß und klein gilt gleich"}},
        {Log_Liste, {1129, "Was an das Gerät ging und was es antwortete"}},
        {Log_Pause, {1130, "Hält die Anzeige an; was inzwischen kommt, erscheint danach"}},
        {Log_Umbruch, {1131, "Zeigt lange Befehle ganz, in mehreren Zeilen"}},
        {Log_Sichern, {1132, "Schreibt alle gezeigten Zeilen in eine Textdatei"}},
        {m_copy, {1133, "Legt die gewählten Zeilen in die Zwischenablage, ohne Auswahl alle"}},
        {m_clear, {1134, "Entfernt alle Zeilen der Anzeige; RDS_log.txt bleibt"}},
        {m_close, {1121, "Schließt nur diese Ansicht; was läuft, läuft weiter"}}};
    for (const auto& [control, tip] : tips) control->setToolTip(text(tip));
}

void LogView::Log_Umbruch_Click(bool wrapped) {
    Log_Liste->setWordWrap(wrapped);
    const int line = Log_Liste->verticalHeader()->defaultSectionSize();
    for (int row = 0; !wrapped && row < m_filtered->rowCount(); ++row) Log_Liste->setRowHeight(row, line);
    fit(0, m_filtered->rowCount() - 1);
}

/// Only these rows: to measure all of them at every command would take its time.
void LogView::fit(int first, int last) {
    if (!Log_Liste->wordWrap()) return;
    for (int row = first; row <= last; ++row) Log_Liste->resizeRowToContents(row);
}

void LogView::Log_Sichern_Click() {
    // What was there at the click.
    saveToChosenFile(m_with, windowTitle(), "log.txt", {998, "Text (*.txt)"},
                     [lines = text().toUtf8()](const QString& file) { return replaceWith(lines, file); });
}

void LogView::copy() {
    QList<int> rows;
    for (const QModelIndex& index : Log_Liste->selectionModel()->selectedRows()) rows << index.row();
    QGuiApplication::clipboard()->setText(text(rows));
}

QString LogView::text(QList<int> rows) const {
    const bool all = rows.isEmpty();
    for (int row = 0; all && row < m_filtered->rowCount(); ++row) rows << row;
    std::sort(rows.begin(), rows.end());
    QString text;
    for (const int row : rows) {
        text += m_log.line(m_filtered->mapToSource(m_filtered->index(row, 0)).row()) + QLatin1Char('\n');
    }
    return text;
}

void LogView::showEvent(QShowEvent* event) {
    QDialog::showEvent(event);
    m_follows = true;
    Log_Liste->scrollToBottom();
}

}  // namespace kdx
