#pragma once

#include <QLabel>
#include <QWidget>

#include <array>
#include <map>
#include <string_view>

#include "ui/valuestate.h"

namespace kdx {

class Captions;

/// Elements of the `Status` array that show a value.
enum class StatusSlot : std::size_t {
    Ta = 0,
    MusicSpeech = 1,
    Pi = 2,
    Ps = 3,
    Pty = 4,
    Tp = 10,
    RfLevel = 13,
    AudioFrequency = 14,
    RfFrequency = 17,
};

/// The row of status indicators: nine headings with a value under each, and `Gen1_Label` before them.
class StatusRow : public QWidget {
    Q_OBJECT
public:
    static constexpr std::size_t kSlots = 18;

    explicit StatusRow(QWidget* parent);

    /// Where a pair that is none of the array's stands: before the others, or beside the level.
    enum class Place { Front, BesideLevel };
    /// Adds a heading with a value under it. @param widest characters of the widest value: its share of the row.
    void add(Place place, QLabel* heading, QLabel* value, int widest);
    /// Adds a small mark under `Gen1_Label`.
    void addMark(QWidget* mark);

    /// Captions the headings in the current language; the values stay.
    void label(const Captions& captions);

    using QWidget::show;
    /// Shows a value; one that is not said to be otherwise is in force.
    void show(StatusSlot slot, const QString& text, const Judgement& judgement = {});
    void show(StatusSlot slot, std::string_view bytes, const Judgement& judgement = {});
    /// Something else sends: until a value is shown again it may not be the one on air. The tip says why.
    void doubt(const QString& tip);
    /// What was doubted is in force again.
    void trust();
    /// What the indicator reads: other handlers decide by it.
    [[nodiscard]] QString text(StatusSlot slot) const;
    /// Light green while an announcement runs, else the look of a button face.
    void setAnnouncing(bool announcing);

private:
    [[nodiscard]] QLabel* at(StatusSlot slot) const { return Status.at(static_cast<std::size_t>(slot)); }

    void addPair(int column, QLabel* heading, QLabel* value, int widest, char letter);

    QLabel* Gen1_Label = nullptr;
    std::array<QLabel*, kSlots> Status{};
    std::map<StatusSlot, Judgement> m_shown;  // as the values were shown last
    bool m_announcing = false;
};

}  // namespace kdx
