#pragma once

#include "tmc/groupcode.h"

#include <QStringList>
#include <QWidget>

#include <array>
#include <cstddef>

class QLabel;

namespace kdx {

class CaptionBook;

/// The bits of the message being composed, each field under its heading. The labels are the only store of the message;
/// a field that has not been touched yet holds "-".
class BitDisplay : public QWidget {
    Q_OBJECT
public:
    enum Field : std::size_t { T, F, Dp, D, U, Extent, Event, Location };

    /// @param book takes the headings.
    BitDisplay(CaptionBook& book, QWidget* parent);

    /// The field holds the number's last bits, as many as it has.
    void set(Field field, double number);
    [[nodiscard]] GroupBits message() const;
    /// Headings of the fields that nobody has chosen.
    [[nodiscard]] QStringList notChosen() const;
    /// Shows or hides all fields; the message stays.
    void showFields(bool shown);

signals:
    void changed();

private:
    static constexpr std::size_t kFields = Location + 1;

    std::array<QLabel*, kFields> m_headings{};
    std::array<QLabel*, kFields> m_bits{};  // TMCBL3_T to TMCBL3_Local
};

}  // namespace kdx
