#include "window/trafficlog.h"

#include <QBrush>
#include <QColor>
#include <QTime>

#include <utility>

#include "base/clock.h"
#include "base/printable.h"
#include "coder/sendparam.h"
#include "settings/captions.h"
#include "ui/text.h"

namespace kdx {

namespace {

constexpr QColor kUnsentColour(0x75, 0x75, 0x75);  // to be read on light and dark

/// A tip is as wide as its longest line.
QString inLines(const QString& text) {
    constexpr qsizetype kLetters = 100;
    QStringList lines;
    for (qsizetype at = 0; at < text.size(); at += kLetters) lines += text.mid(at, kLetters);
    return lines.join(QLatin1Char('\n'));
}

}  // namespace

TrafficLog::TrafficLog(Instrument& instrument, const Clock& clock, QObject* parent)
    : QAbstractTableModel(parent), m_instrument(instrument), m_clock(clock) {
    m_instrument.addWatcher(*this);
}

TrafficLog::~TrafficLog() {
    m_instrument.removeWatcher(*this);
}

void TrafficLog::passed(const Traffic& traffic) {
    const Kind kind = traffic.kind == Traffic::Kind::Written ? Kind::Written
                      : traffic.kind == Traffic::Kind::Read  ? Kind::Read
                                                             : Kind::Logged;
    take({now(), kind, traffic.text, traffic.status});
}

void TrafficLog::composed(const std::string& command) {
    take({now(), Kind::Unsent, command});
}

int TrafficLog::now() const {
    return static_cast<int>(m_clock.secondsSinceMidnight() * 1000);
}

void TrafficLog::take(const Line& line) {
    if (!m_held) return add(line);
    m_waiting.push_back(line);
    if (m_waiting.size() > 2 * kMostLines) m_waiting.pop_front();  // each line of the table may have come in two parts
}

void TrafficLog::add(const Line& line) {
    if (!m_lines.empty() && tellsTheLast(line)) {
        if (line.kind == Kind::Logged) return;
        const auto last = static_cast<int>(m_lines.size()) - 1;
        m_lines.back() = line;
        emit dataChanged(index(last, 0), index(last, ColumnCount - 1));
        return;
    }
    if (m_lines.size() == kMostLines) {
        beginRemoveRows({}, 0, 0);
        m_lines.pop_front();
        endRemoveRows();
    }
    const auto row = static_cast<int>(m_lines.size());
    beginInsertRows({}, row, row);
    m_lines.push_back(line);
    endInsertRows();
}

/// Whether it is about the same command, question or answer as the last line: each is logged as well.
bool TrafficLog::tellsTheLast(const Line& line) const {
    const Line& last = m_lines.back();
    const auto quoted = [](const std::string& text) { return '"' + text + '"'; };
    switch (line.kind) {
        case Kind::Unsent:
            return last.kind == Kind::Logged && last.text.ends_with("= " + quoted(line.text));
        case Kind::Written:
            return last.kind == Kind::Unsent && last.text == line.text;
        case Kind::Read:
            return false;
        case Kind::Logged:
            break;
    }
    if (last.kind == Kind::Read) return line.text.find("= Answer ") != std::string::npos;
    if (last.kind != Kind::Written) return false;
    if (line.text.ends_with("= " + last.text)) return true;
    return last.text.ends_with('?') && line.text.ends_with(quoted(last.text.substr(0, last.text.size() - 1)));
}

void TrafficLog::setHeld(bool held) {
    m_held = held;
    if (held) return;
    for (const Line& line : std::exchange(m_waiting, {})) add(line);
}

void TrafficLog::clear() {
    beginResetModel();
    m_lines.clear();
    m_waiting.clear();
    endResetModel();
}

void TrafficLog::label(const Captions& captions) {
    m_headings = {toText(captions.own(681, "Zeit")), toText(captions.own(682, "Richtung")),
                  toText(captions.own(683, "Text")), toText(captions.own(684, "Status"))};
    m_unsent = toText(captions.own(995, "nicht gesendet"));
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
    switch (role) {
        case Qt::DisplayRole:
            return cell(line, index.column());
        case Qt::ToolTipRole:
            return inLines(cell(line, Text));
        case Qt::ForegroundRole:
            if (line.status < 0 || endsItsTextEarly(line.text)) return QBrush(Qt::red);
            if (line.kind == Kind::Unsent) return QBrush(kUnsentColour);
            return {};
        default:
            return {};
    }
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
                case Kind::Written:
                case Kind::Unsent:
                    return QStringLiteral("->");
                case Kind::Read:
                    return QStringLiteral("<-");
                case Kind::Logged:
                    return QStringLiteral("log");
            }
            return {};
        case Text:
            return toText(printableLine(line.text, '\xB7'));
        default:
            if (line.kind == Kind::Unsent) return m_unsent;
            return line.kind == Kind::Logged ? QString() : QString::number(line.status);
    }
}

}  // namespace kdx
