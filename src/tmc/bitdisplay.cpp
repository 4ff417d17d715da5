#include "tmc/bitdisplay.h"

#include "tmc/valuelabel.h"
#include "ui/caption.h"
#include "ui/layouts.h"
#include "ui/text.h"

namespace kdx {

namespace {

struct FieldRow {
    const char* name;
    int bits;
    int heading;  // number of its caption
    const char* design;
};
// From left to right, in the order of BitDisplay::Field.
constexpr std::array kRows = {
    FieldRow{"TMCBL3_T", 1, 574, "T"},          FieldRow{"TMCBL3_F", 1, 575, "F"},
    FieldRow{"TMCBL3_DP", 3, 576, "DP"},        FieldRow{"TMCBL3_D", 1, 577, "D"},
    FieldRow{"TMCBL3_U", 1, 578, "U"},          FieldRow{"TMCBL3_Extent", 3, 579, "Extent"},
    FieldRow{"TMCBL3_Event", 11, 580, "Event"}, FieldRow{"TMCBL3_Local", 16, 581, "Location"},
};

}  // namespace

BitDisplay::BitDisplay(CaptionBook& book, QWidget* parent) : QWidget(parent) {
    static_assert(kRows.size() == kFields);
    auto* fields = grid({});
    for (std::size_t field = 0; field < kFields; ++field) {
        const FieldRow& row = kRows.at(field);
        m_headings.at(field) = book.captioned<QLabel>("", {row.heading, row.design}, this);
        auto* bits = named<ValueLabel>(row.name, this);
        bits->setText(QStringLiteral("-"));
        bits->makeRoomFor(row.bits);
        m_bits.at(field) = bits;
        fields->addWidget(m_headings.at(field), 0, static_cast<int>(field), Qt::AlignHCenter);
        fields->addWidget(bits, 1, static_cast<int>(field), Qt::AlignHCenter);
    }
    layOut(this, fields, 0);
}

void BitDisplay::set(Field field, double number) {
    m_bits.at(field)->setText(toText(lastBits(number, static_cast<std::size_t>(kRows.at(field).bits))));
    emit changed();
}

GroupBits BitDisplay::message() const {
    const auto bits = [this](Field field) { return toBytes(m_bits.at(field)->text()); };
    return {bits(T), bits(F), bits(Dp), bits(D), bits(U), bits(Extent), bits(Event), bits(Location)};
}

QStringList BitDisplay::notChosen() const {
    QStringList headings;
    for (std::size_t field = 0; field < kFields; ++field) {
        if (m_bits.at(field)->text() == QLatin1String("-")) headings.append(m_headings.at(field)->text());
    }
    return headings;
}

void BitDisplay::showFields(bool shown) {
    for (QLabel* heading : m_headings) heading->setVisible(shown);
    for (QLabel* bits : m_bits) bits->setVisible(shown);
}

}  // namespace kdx
