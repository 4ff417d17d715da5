#include "onair/radioface.h"

#include <QGridLayout>
#include <QLabel>

#include "air/shadow.h"
#include "base/numbers.h"
#include "coder/fieldsizes.h"
#include "onair/differences.h"
#include "onair/displays.h"
#include "onair/tables.h"
#include "onair/warningtexts.h"
#include "settings/captions.h"
#include "ui/layouts.h"
#include "ui/text.h"

namespace kdx {

namespace {

/// As AirDifference::Row counts, and the clock behind.
enum Row { Pi, Ps, Radiotext, Pty, Tp, Ta, MusicSpeech, DecoderInfo, StereoMode, ClockTime };

struct RowCaption {
    const char* name;
    Caption caption;
};
const RowCaption kHeadings[] = {
    {"Air_PI", {725, "PI"}}, {"Air_PS", {723, "PS"}}, {"Air_RT", {49}}, {"Air_PTY", {726, "PTY"}},
    {"Air_TP", {727, "TP"}}, {"Air_TA", {728, "TA"}}, {"Air_MS", {55}}, {"Air_DI", {829, "DI"}},
    {"Air_Stereo", {29}},    {"Air_CT", {54}},
};
constexpr int kFirstStereoMode = 361;  // the captions of the panel
constexpr const char* kStereoModes[] = {"links", "rechts", "links = rechts", "links = -rechts", "links =/ rechts"};

QString clockText(const air::RadioState::ClockTime& clock) {
    using namespace std::chrono;
    const auto local = clock.local().time_since_epoch();
    const year_month_day date{sys_days{floor<days>(local)}};
    const auto minute = local - floor<days>(local);
    return QStringLiteral("%1-%2-%3 %4:%5")
        .arg(static_cast<int>(date.year()), 4, 10, QLatin1Char('0'))
        .arg(static_cast<unsigned>(date.month()), 2, 10, QLatin1Char('0'))
        .arg(static_cast<unsigned>(date.day()), 2, 10, QLatin1Char('0'))
        .arg(minute.count() / 60, 2, 10, QLatin1Char('0'))
        .arg(minute.count() % 60, 2, 10, QLatin1Char('0'));
}

}  // namespace

RadioFace::RadioFace(const PageContext& with, QWidget* parent) : QGroupBox(parent), m_with(with) {
    static_assert(std::size(kHeadings) == kRows);
    setObjectName(QStringLiteral("Air_Radio"));
    m_book.text(this, {722, "Radio"});
    for (std::size_t i = 0; i < kRows; ++i) {
        Row& row = m_rows.at(i);
        const QString name = QString::fromLatin1(kHeadings[i].name);
        row.heading = m_book.captioned<QLabel>("", kHeadings[i].caption, this);
        row.value = i == Ps          ? new NameDisplay(this)
                    : i == Radiotext ? static_cast<QLabel*>(new TextDisplay(this))
                                     : new QLabel(this);
        row.value->setObjectName(name);
        if (i != Ps && i != Radiotext) {
            row.value->setTextInteractionFlags(Qt::TextSelectableByMouse | Qt::TextSelectableByKeyboard);
            row.value->setFocusPolicy(Qt::StrongFocus);
        }
        m_book.spokenAs(row.value, row.heading);
        row.sign = new QLabel(this);
        row.sign->setObjectName(name + QStringLiteral("_Zeichen"));
        row.sign->setFixedWidth(fontMetrics().horizontalAdvance(QString(kDifferenceSign)) + 4);
    }
    m_rows[Ps].value->setText(QString(static_cast<int>(kPsLength), QLatin1Char(' ')));
    arrange();
}

void RadioFace::arrange() {
    auto* grid = new QGridLayout;
    grid->setHorizontalSpacing(kGap);
    grid->setVerticalSpacing(3);
    const auto place = [this, grid](std::size_t which, int row, int column, int columns) {
        const Row& shown = m_rows.at(which);
        grid->addWidget(shown.heading, row, column);
        grid->addWidget(shown.value, row, column + 1, 1, columns);
        grid->addWidget(shown.sign, row, column + 1 + columns);
    };
    place(Ps, 0, 0, 4);
    place(Radiotext, 1, 0, 4);
    place(Pi, 2, 0, 1);
    place(Pty, 2, 3, 1);
    place(Tp, 3, 0, 1);
    place(MusicSpeech, 3, 3, 1);
    place(Ta, 4, 0, 1);
    place(StereoMode, 4, 3, 1);
    place(ClockTime, 5, 0, 1);
    place(DecoderInfo, 5, 3, 1);
    grid->setColumnStretch(1, 1);
    grid->setColumnStretch(4, 1);
    layOut(this, grid);
}

QString RadioFace::caption(const Caption& caption) const {
    return captionText(m_with.captions, caption);
}

void RadioFace::label() {
    m_book.label(m_with.captions);
}

void RadioFace::show(const air::Shadow& shadow, const Station& station) {
    showValues(shadow);
    std::array<QString, kRows> reasons;
    for (const AirDifference& difference : differences(shadow, station))
        reasons.at(static_cast<std::size_t>(difference.row)) = reasonOf(difference);
    for (std::size_t i = 0; i < kRows; ++i) mark(m_rows.at(i), reasons.at(i));
}

void RadioFace::showValues(const air::Shadow& shadow) {
    const air::RadioState& radio = shadow.radio();
    const auto onOff = [this](std::optional<bool> flag) { return flag ? caption({*flag ? 192 : 193}) : QString(); };
    showText(m_rows[Pi].value, radio.pi ? QString::fromStdString(hexDigits(*radio.pi, 4)) : QString());
    showText(m_rows[Ps].value, QString::fromStdString(radio.psText()));
    showText(m_rows[Radiotext].value, QString::fromStdString(radio.radiotextText()));
    QString type;
    if (radio.pty) {
        type = toText(m_with.captions.programmeType(static_cast<std::size_t>(*radio.pty)));
        if (type.isEmpty()) type = QString::number(*radio.pty);
    }
    showText(m_rows[Pty].value, type);
    showText(m_rows[Tp].value, onOff(radio.tp));
    showText(m_rows[Ta].value, onOff(radio.ta));
    showText(m_rows[MusicSpeech].value, radio.music ? caption({*radio.music ? 56 : 57}) : QString());
    const auto decoderInfo = radio.decoderInfoNumber();
    showText(m_rows[DecoderInfo].value, decoderInfo ? QString::number(*decoderInfo) : QString());
    const sim::Setup& sent = shadow.transmission().settings;
    const int mode = sent.stereoMode - 1;
    showText(m_rows[StereoMode].value,
             sent.stereoOn ? caption({kFirstStereoMode + mode, kStereoModes[mode]}) : caption({193}));
    showText(m_rows[ClockTime].value, radio.clock ? clockText(*radio.clock) : QString());
}

QString RadioFace::reasonOf(const AirDifference& difference) const {
    const QString entry = QLatin1Char('"') + toText(difference.entry) + QLatin1Char('"');
    switch (difference.why) {
        case AirDifference::Why::Refused:
            return refusalText(difference.entry, entry, m_with.captions, m_with.state);
        case AirDifference::Why::Cut:
            return caption({792, "Für die Anzeige gekürzt; eingegeben ist %1"}).arg(entry);
        case AirDifference::Why::Padded:
            return caption({793, "Mit Leerzeichen aufgefüllt; eingegeben ist %1"}).arg(entry);
        case AirDifference::Why::NoPlace:
            return caption({794, "RDS kennt das Zeichen %1 nicht: das Radio zeigt ein Leerzeichen"}).arg(entry);
        case AirDifference::Why::Other:
            break;
    }
    if (difference.row == AirDifference::Row::StereoMode && !difference.entry.empty()) {
        const auto mode = difference.entry.front() - '0';
        if (mode >= 0 && mode < static_cast<int>(std::size(kStereoModes))) {
            const QString why = caption({795, "Im Fenster heißt diese Einstellung %1"})
                                    .arg(caption({kFirstStereoMode + mode, kStereoModes[mode]}));
            return withRemedy(why, &Corrections::stereoMode, m_with.captions, m_with.state);
        }
    }
    return caption({790, "Eingegeben ist %1"}).arg(entry);
}

void RadioFace::mark(Row& row, const QString& why) const {
    if (row.sign->toolTip() == why) return;
    row.sign->setToolTip(why);
    row.value->setToolTip(why);
    row.value->setAccessibleDescription(why);
    row.sign->setText(why.isEmpty() ? QString() : QString(kDifferenceSign));
    const QColor colour = markColour(this);
    for (QLabel* label : {row.heading, row.sign, row.value}) {
        QPalette marked = palette();
        if (!why.isEmpty()) marked.setColor(QPalette::WindowText, colour);
        label->setPalette(marked);
    }
}

QString RadioFace::text() const {
    QString text;
    for (const Row& row : m_rows) {
        text += row.heading->text() + QLatin1Char('\t') + row.value->text();
        if (const QString why = row.sign->toolTip(); !why.isEmpty())
            text += QLatin1Char('\t') + QString(kDifferenceSign) + QLatin1Char(' ') + why;
        text += QLatin1Char('\n');
    }
    return text;
}

}  // namespace kdx
