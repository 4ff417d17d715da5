#include "window/progressline.h"

#include <QHBoxLayout>
#include <QLabel>
#include <QProgressBar>

#include <algorithm>

#include "ui/named.h"

namespace kdx {

ProgressLine::ProgressLine(QWidget* parent) : QWidget(parent) {
    m_text = named<QLabel>("QuietLine", this);
    m_text->setTextFormat(Qt::PlainText);
    m_text->setSizePolicy(QSizePolicy::Ignored, QSizePolicy::Fixed);
    m_bar = named<QProgressBar>("ProgressBar", this);
    m_bar->setTextVisible(false);
    m_bar->setFixedSize(160, m_text->fontMetrics().height() - 3);
    m_bar->hide();
    setFixedHeight(m_text->fontMetrics().height());
    auto* row = new QHBoxLayout(this);
    row->setContentsMargins(0, 0, 0, 0);
    row->setSpacing(8);
    row->addWidget(m_text, 1);
    row->addWidget(m_bar);
}

void ProgressLine::setNotice(const QString& notice) {
    m_notice = notice;
    m_text->setToolTip(notice);
    if (!m_counting) m_text->setText(notice);
}

void ProgressLine::begin(const QString& pattern, int total) {
    m_pattern = pattern;
    m_counting = true;
    m_sent = 0;
    m_total = total;
    m_bar->show();
    layout()->activate();  // no event will do it before the end
    showCount();
}

void ProgressLine::step() {
    if (!m_counting) return;
    ++m_sent;
    m_total = std::max(m_total, m_sent);
    showCount();
}

void ProgressLine::addToTotal(int commands) {
    if (m_counting) m_total = std::max(m_total + commands, m_sent);
}

void ProgressLine::end() {
    m_counting = false;
    m_bar->hide();
    m_text->setText(m_notice);
}

void ProgressLine::showCount() {
    m_text->setText(m_pattern.arg(m_sent).arg(m_total));
    m_bar->setRange(0, std::max(m_total, 1));
    m_bar->setValue(m_sent);
    m_text->repaint();
    m_bar->repaint();
}

}  // namespace kdx
