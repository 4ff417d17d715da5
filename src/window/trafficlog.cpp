#include "window/trafficlog.h"

#include <QBrush>
#include <QTime>

#include "base/clock.h"
#include "base/printable.h"
#include "coder/sendparam.h"
#include "settings/captions.h"
#include "ui/text.h"

namespace kdx {

TrafficLog::TrafficLog(Instrument& instrument, const Clock& clock, QObject* parent)
    : QAbstractTableModel(parent), m_instrument(instrument), m_clock(clock) {
    m_instrument.addWatcher(*this);
}

TrafficLog::~TrafficLog() {
    m_instrument.removeWatcher(*this);
}

void TrafficLog::passed(const Traffic& traffic) {
    if (m_lines.size() == kMostLines) {
        beginRemoveRows({}, 0, 0);
        m_lines.pop_front();
        endRemoveRows();
    }
    const auto row = static_cast<int>(m_lines.size());
    beginInsertRows({}, row, row);
    m_lines.push_back(
        {static_cast<int>(m_clock.secondsSinceMidnight() * 1000), traffic.kind, traffic.text, traffic.status});
    endInsertRows();
}

void TrafficLog::clear() {
    beginResetModel();
    m_lines.clear();
    endResetModel();
}

void TrafficLog::label(const Captions& captions) {
    m_headings = {toText(captions.own(681, "Zeit")), toText(captions.own(682, "Richtung")),
                  toText(captions.own(683, "Text")), toText(captions.own(684, "Status"))};
    emit headerDataChanged(Qt::Horizontal, 0, ColumnCount - 1);
}

QString TrafficLog::line(int row) const {
    const Line& line = m_lines.at(static_cast<std::size_t>(row));
    QStringList cells;
    for (int column = 0; column < ColumnCount; ++column) cells << cell(line, column);
    return cells.join(QLatin1Char('\t'));
}

int TrafficLog::rowCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : static_cast<int>(m_lines.size());
}

int TrafficLog::columnCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : ColumnCount;
}

QVariant TrafficLog::data(const QModelIndex& index, int role) const {
    if (!index.isValid()) return {};
    const Line& line = m_lines.at(static_cast<std::size_t>(index.row()));
    if (role == Qt::DisplayRole) return cell(line, index.column());
    if (role == Qt::ForegroundRole && (line.status < 0 || endsItsTextEarly(line.text))) return QBrush(Qt::red);
    return {};
}

QVariant TrafficLog::headerData(int section, Qt::Orientation orientation, int role) const {
    if (orientation != Qt::Horizontal || role != Qt::DisplayRole) return {};
    return m_headings.value(section);
}

QString TrafficLog::cell(const Line& line, int column) const {
    switch (column) {
        case Time:
            return QTime::fromMSecsSinceStartOfDay(line.milliseconds).toString(QStringLiteral("HH:mm:ss.zzz"));
        case Direction:
            switch (line.kind) {
                case Traffic::Kind::Written:
                    return QStringLiteral("->");
                case Traffic::Kind::Read:
                    return QStringLiteral("<-");
                case Traffic::Kind::Logged:
                    return QStringLiteral("log");
            }
            return {};
        case Text:
            return toText(printableLine(line.text, '\xB7'));
        default:
            return line.kind == Traffic::Kind::Logged ? QString() : QString::number(line.status);
    }
}

}  // namespace kdx
