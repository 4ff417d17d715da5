#include "window/progressline.h"

#include <QHBoxLayout>
#include <QLabel>
#include <QProgressBar>
#include <QPushButton>

#include "ui/elided.h"
#include "ui/named.h"

namespace kdx {

namespace {

constexpr int kButtonRoom = 6;  // above and below a caption, in pixels at 96 dpi

}  // namespace

ProgressLine::ProgressLine(QWidget* parent) : QWidget(parent) {
    m_text = named<QLabel>("QuietLine", this);
    m_text->setSizePolicy(QSizePolicy::Ignored, QSizePolicy::Fixed);
    elideLongText(*m_text);
    m_bar = named<QProgressBar>("ProgressBar", this);
    m_bar->setTextVisible(false);
    m_bar->setFixedSize(160, m_text->fontMetrics().height() - 3);
    m_bar->hide();
    Stop_Taste = addButton("Stop_Taste");
    Panik_Taste = addButton("Panik_Taste");
    setFixedHeight(m_text->fontMetrics().height() + kButtonRoom);  // nothing moves when a button comes or goes
    auto* row = new QHBoxLayout(this);
    row->setContentsMargins(0, 0, 0, 0);
    row->setSpacing(8);
    row->addWidget(m_text, 1);
    row->addWidget(m_bar);
    row->addWidget(Stop_Taste);
    row->addWidget(Panik_Taste);
}

QPushButton* ProgressLine::addButton(const char* name) {
    auto* button = named<QPushButton>(name, this);
    button->setFixedHeight(fontMetrics().height() + kButtonRoom);
    button->setFocusPolicy(Qt::TabFocus);  // a click leaves the cursor where it is
    button->hide();
    return button;
}

void ProgressLine::setNotice(const QString& notice) {
    m_notice = notice;
    m_text->setToolTip(notice);
    if (!m_counting) m_text->setText(notice);
}

void ProgressLine::showWait(const QString& text) {
    m_counting = true;
    m_text->setText(text);
    m_text->repaint();
}

void ProgressLine::showProgress(const QString& pattern, std::size_t number, std::size_t total) {
    m_counting = true;
    if (m_bar->isHidden()) {
        m_bar->show();
        layout()->activate();  // no event will do it before the end
    }
    m_text->setText(pattern.arg(number).arg(total));
    m_bar->setRange(0, static_cast<int>(total));
    m_bar->setValue(static_cast<int>(number));
    m_text->repaint();
    m_bar->repaint();
}

void ProgressLine::endProgress() {
    m_counting = false;
    m_bar->hide();
    m_text->setText(m_notice);
}

}  // namespace kdx
