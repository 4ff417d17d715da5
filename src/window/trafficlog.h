#pragma once

#include <QAbstractTableModel>

#include <deque>

#include "link/instrument.h"

namespace kdx {

class Captions;
class Clock;

/// The latest lines of what was written, read and logged, oldest first, as a table of time, direction, text and status.
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
    void clear();
    /// Headings in the current language.
    void label(const Captions& captions);

    /// The line as text with tabs between its columns.
    [[nodiscard]] QString line(int row) const;

    [[nodiscard]] int rowCount(const QModelIndex& parent = {}) const override;
    [[nodiscard]] int columnCount(const QModelIndex& parent = {}) const override;
    [[nodiscard]] QVariant data(const QModelIndex& index, int role) const override;
    [[nodiscard]] QVariant headerData(int section, Qt::Orientation orientation, int role) const override;

private:
    struct Line {
        int milliseconds = 0;  ///< since midnight
        Traffic::Kind kind = Traffic::Kind::Logged;
        std::string text;
        VisaStatus status = 0;
    };
    [[nodiscard]] QString cell(const Line& line, int column) const;

    Instrument& m_instrument;
    const Clock& m_clock;
    std::deque<Line> m_lines;
    QStringList m_headings{QString(), QString(), QString(), QString()};
};

}  // namespace kdx
