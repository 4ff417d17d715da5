#include "ui/statusrow.h"

#include <QGridLayout>

#include <algorithm>

#include "settings/captions.h"
#include "ui/controls.h"
#include "ui/elided.h"
#include "ui/named.h"
#include "ui/text.h"

namespace kdx {

namespace {

struct Pair {
    std::size_t heading;
    const char* caption;
    std::size_t value;
    const char* design;
    int widest;         ///< characters of the widest value: its share of the row
    char letter = '0';  ///< one as wide as those of the value
};

// From left to right on the screen.
constexpr std::array kPairs = {
    Pair{16, "RF [MHz]", 17, "--", 8}, Pair{12, "RF [dBµV]", 13, "--", 6}, Pair{15, "AF [kHz]", 14, "--", 6},
    Pair{7, "PI", 2, "Label1", 4},     Pair{6, "PS", 3, "Label1", 8, 'M'}, Pair{11, "TP", 10, "Label1", 3},
    Pair{9, "TA", 0, "TA", 3},         Pair{8, "M / S", 1, "Label1", 7},   Pair{5, "PTY", 4, "Label1", 16, 'e'},
};

constexpr int kFirstPair = 2;  // the columns between the pairs are free for further ones

QFont arial(const QFont& base) {
    QFont font = base;
    font.setFamilies(arialFamilies());
    return font;
}

}  // namespace

StatusRow::StatusRow(QWidget* parent) : QWidget(parent) {
    auto* grid = new QGridLayout(this);
    grid->setContentsMargins(0, 0, 0, 0);
    grid->setHorizontalSpacing(3);
    grid->setVerticalSpacing(1);
    Gen1_Label = named<QLabel>("Gen1_Label", QStringLiteral("Status :"), this);
    grid->addWidget(Gen1_Label, 0, 0);
    int column = kFirstPair;
    for (const Pair& pair : kPairs) {
        Status[pair.heading] = element<QLabel>("Status", pair.heading, QString::fromUtf8(pair.caption), this);
        Status[pair.value] = element<QLabel>("Status", pair.value, QString::fromUtf8(pair.design), this);
        Status[pair.value]->setAccessibleName(QString::fromUtf8(pair.caption));
        addPair(column, Status[pair.heading], Status[pair.value], pair.widest, pair.letter);
        showState(*Status[pair.value], ValueState::Unsent, {});
        Status[pair.value]->setProperty("zustand", QString());  // a caption is no value
        column += 2;
    }
}

void StatusRow::addPair(int column, QLabel* heading, QLabel* value, int widest, char letter) {
    for (QLabel* label : {heading, value}) {
        label->setFont(arial(font()));
        label->setAlignment(Qt::AlignCenter);
    }
    value->setFrameStyle(QFrame::Panel | QFrame::Sunken);
    value->setAutoFillBackground(true);
    const QString sample(widest, QLatin1Char(letter));
    // The design caption, too, fits its field: it stands there until the first session.
    const QFontMetrics letters = value->fontMetrics();
    value->setMinimumWidth(std::max(letters.horizontalAdvance(sample), letters.horizontalAdvance(value->text())) + 6);
    value->setSizePolicy(QSizePolicy::Ignored, QSizePolicy::Fixed);
    elideLongText(*value);
    auto* grid = static_cast<QGridLayout*>(layout());
    grid->addWidget(heading, 0, column);
    grid->addWidget(value, 1, column);
    grid->setColumnStretch(column, widest);
}

void StatusRow::add(Place place, QLabel* heading, QLabel* value, int widest) {
    addPair(place == Place::Front ? kFirstPair - 1 : kFirstPair + 3, heading, value, widest, '0');
}

void StatusRow::addMark(QWidget* mark) {
    static_cast<QGridLayout*>(layout())->addWidget(mark, 1, 0, Qt::AlignCenter);
}

void StatusRow::label(const Captions& captions) {
    Gen1_Label->setText(toText(captions.own(307, "Status :")));
    Status[16]->setText(toText(captions.text(220)));
    Status[12]->setText(toText(captions.text(221)));
    Status[15]->setText(toText(captions.text(222)));
}

void StatusRow::show(StatusSlot slot, const QString& text, const Judgement& judgement) {
    at(slot)->setText(text);
    at(slot)->setToolTip(text);
    m_shown[slot] = judgement;
    showState(*at(slot), judgement.state, judgement.tip);
}

void StatusRow::doubt(const QString& tip) {
    for (const auto& [slot, judgement] : m_shown) showState(*at(slot), ValueState::Unsent, tip);
}

void StatusRow::trust() {
    for (const auto& [slot, judgement] : m_shown) showState(*at(slot), judgement.state, judgement.tip);
    setAnnouncing(m_announcing);
}

void StatusRow::show(StatusSlot slot, std::string_view bytes, const Judgement& judgement) {
    show(slot, toText(bytes), judgement);
}

QString StatusRow::text(StatusSlot slot) const {
    return at(slot)->text();
}

void StatusRow::setAnnouncing(bool announcing) {
    m_announcing = announcing;
    QPalette palette = at(StatusSlot::Ta)->palette();
    const QPalette window = QWidget::palette();
    // Light green of the standard sixteen colours, with black text whatever the theme.
    palette.setColor(QPalette::Window, announcing ? QColor(0, 255, 0) : window.color(QPalette::Button));
    palette.setColor(QPalette::WindowText, announcing ? QColor(Qt::black) : window.color(QPalette::ButtonText));
    at(StatusSlot::Ta)->setPalette(palette);
}

}  // namespace kdx
