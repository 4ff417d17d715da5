#pragma once

#include <QGroupBox>

#include <array>
#include <cstddef>

#include "ui/caption.h"
#include "ui/pagecontext.h"

class QLabel;

namespace kdx {

struct AirDifference;
struct Station;
namespace air {
class Shadow;
}

/// What a radio shows of the programme, each row marked where the window says something else.
class RadioFace : public QGroupBox {
public:
    RadioFace(const PageContext& with, QWidget* parent);

    void label();
    void show(const air::Shadow& shadow, const Station& station);
    /// All of it as text, a row a line.
    [[nodiscard]] QString text() const;

private:
    static constexpr std::size_t kRows = 10;
    struct Row {
        QLabel* heading = nullptr;
        QLabel* value = nullptr;
        QLabel* sign = nullptr;
    };
    void arrange();
    void showValues(const air::Shadow& shadow);
    void mark(Row& row, const QString& why) const;
    [[nodiscard]] QString reasonOf(const AirDifference& difference) const;
    [[nodiscard]] QString caption(const Caption& caption) const;

    PageContext m_with;
    CaptionBook m_book;
    std::array<Row, kRows> m_rows;
};

}  // namespace kdx
