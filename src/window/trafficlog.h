#pragma once

#include <QAbstractTableModel>

#include <deque>
#include <string>
#include <vector>

#include "link/instrument.h"

namespace kdx {

class Captions;
class Clock;

/// The latest of what was written, read and logged, oldest first, as a table of time, direction, text and status: a
/// line a command, a question or an answer, and one for what was logged beside them.
class TrafficLog : public QAbstractTableModel, public TrafficWatcher {
    Q_OBJECT
public:
    enum Column { Time, Direction, Text, Status, ColumnCount };
    /// How many lines are kept; the oldest go first.
    static constexpr std::size_t kMostLines = 4000;

    /// Listens to the link from now on. @param clock says when it happened.
    TrafficLog(Instrument& instrument, const Clock& clock, QObject* parent);
    ~TrafficLog() override;

    void passed(const Traffic& traffic) override;
    /// What was logged last is this command; it is written next when a session is open.
    void composed(const std::string& command);
    void clear();
    /// While it is held nothing is added; what came meanwhile follows afterwards.
    void setHeld(bool held);
    /// Headings and words in the current language.
    void label(const Captions& captions);

    /// The line as text with tabs between its columns.
    [[nodiscard]] QString line(int row) const;

    [[nodiscard]] int rowCount(const QModelIndex& parent = {}) const override;
    [[nodiscard]] int columnCount(const QModelIndex& parent = {}) const override;
    [[nodiscard]] QVariant data(const QModelIndex& index, int role) const override;
    [[nodiscard]] QVariant headerData(int section, Qt::Orientation orientation, int role) const override;

private:
    enum class Kind { Written, Read, Logged, Unsent };
    struct Line {
        int milliseconds = 0;  ///< since midnight
        Kind kind = Kind::Logged;
        std::string text;
        VisaStatus status = 0;
    };
    [[nodiscard]] int now() const;
    void take(const Line& line);
    void add(const Line& line);
    [[nodiscard]] bool tellsTheLast(const Line& line) const;
    [[nodiscard]] QString cell(const Line& line, int column) const;

    Instrument& m_instrument;
    const Clock& m_clock;
    std::deque<Line> m_lines;
    bool m_held = false;
    std::deque<Line> m_waiting;
    QStringList m_headings{QString(), QString(), QString(), QString()};
    QString m_unsent;
};

}  // namespace kdx
