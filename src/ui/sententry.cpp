#include "ui/sententry.h"

#include <QPainter>

#include "base/numbers.h"
#include "coder/fieldsizes.h"
#include "settings/withoutcontrols.h"
#include "ui/caption.h"
#include "ui/text.h"

namespace kdx {

SentEntry::SentEntry(const PageContext& with, const char* key, QWidget* parent)
    : QLineEdit(parent), m_with(with), m_key(key), m_sent(with, key) {
    connect(this, &QLineEdit::textChanged, this, &SentEntry::refresh);
}

void SentEntry::goesOut(std::string_view value) {
    m_sent.goesOut(sentForm(value));
    refresh();
}

void SentEntry::wentOut(std::string_view value) {
    m_sent.wentOut(sentForm(value));
    refresh();
}

void SentEntry::forget() {
    m_sent.forget();
    refresh();
}

void SentEntry::refresh() {
    const Judgement judgement = judge(text());
    showState(*this, judgement.state, judgement.tip);
}

QString SentEntry::toShown(std::string_view value) {
    return toText(value);
}

Judgement SentEntry::judge(const QString& entry) const {
    if (entry.isEmpty() && !m_sent.isKnown()) return {};  // of nothing there is nothing to be sent
    return m_sent.judge(sentForm(toBytes(entry)), entry);
}

std::string SentEntry::sentForm(std::string_view value) const {
    const std::string_view key = m_key;
    std::string plain = withoutControls(value);
    if (key == "PS" || key == "EON_PS") return padRight(plain, kPsLength);
    if (key == "PI" || key == "EON_PI") return padRight(plain, kPiLength);
    return plain;
}

void SentEntry::paintEvent(QPaintEvent* event) {
    QLineEdit::paintEvent(event);
    if (!isEnabled() || judge(text()).state != ValueState::Unsent) return;
    constexpr int kSide = 6;
    const QString note = captionText(m_with.captions, {856, "noch nicht gesendet"});
    const int free = width() - fontMetrics().horizontalAdvance(text()) - 3 * kSide;
    if (fontMetrics().horizontalAdvance(note) > free) return;  // the colour and the tip tell it still
    QPainter painter(this);
    QFont slanted = font();
    slanted.setItalic(true);
    painter.setFont(slanted);
    painter.setPen(QColor(0x80, 0x60, 0));
    painter.drawText(rect().adjusted(kSide, 0, -kSide, 0), Qt::AlignRight | Qt::AlignVCenter, note);
}

}  // namespace kdx
