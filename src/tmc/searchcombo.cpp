#include "tmc/searchcombo.h"

#include <QFrame>
#include <QKeyEvent>
#include <QLineEdit>
#include <QListView>
#include <QScreen>
#include <QScrollBar>

#include <algorithm>

#include "tmc/foundentries.h"
#include "ui/layouts.h"

namespace kdx {

namespace {

constexpr int kEntries = 16;  // that are seen at a time

}  // namespace

SearchCombo::SearchCombo(QWidget* parent) : QComboBox(parent), m_found(new FoundEntries(this)) {
    m_popup = new QFrame(this, Qt::Popup);
    m_popup->setFrameShape(QFrame::StyledPanel);
    m_search = new QLineEdit(m_popup);
    m_search->installEventFilter(this);
    m_list = new QListView(m_popup);
    m_list->setUniformItemSizes(true);  // else every entry is measured before the first is shown
    m_list->setFrameShape(QFrame::NoFrame);
    m_list->setFocusPolicy(Qt::NoFocus);
    m_list->setMouseTracking(true);
    m_list->setModel(m_found);
    layOut(m_popup, column({m_search, {m_list, 1}}), 2);
    connect(m_search, &QLineEdit::textChanged, this, &SearchCombo::search);
    connect(m_list, &QListView::clicked, this, &SearchCombo::choose);
    connect(m_list, &QListView::entered, m_list, &QListView::setCurrentIndex);
}

void SearchCombo::nameParts() {
    m_search->setObjectName(objectName() + QStringLiteral("_Suche"));
    m_list->setObjectName(objectName() + QStringLiteral("_Treffer"));
}

void SearchCombo::showPopup() {
    // Its picture is looked for in all folders of icon themes, so not already while the program starts.
    m_search->setClearButtonEnabled(true);
    m_search->clear();
    search({});
    place();
    m_popup->show();
    m_search->setFocus();
    m_list->scrollTo(m_list->currentIndex(), QAbstractItemView::PositionAtCenter);
}

void SearchCombo::hidePopup() {
    m_popup->hide();
    QComboBox::hidePopup();
}

/// Under the box where there is room, else above it; as wide as an entry.
void SearchCombo::place() {
    const QRect screen = this->screen()->availableGeometry();
    const int rowHeight = std::max(m_list->sizeHintForRow(0), fontMetrics().height());
    const int entries = std::clamp(m_found->rowCount(), 4, kEntries);
    const int frame = 2 * m_popup->frameWidth() + 4;
    const int height =
        std::min(m_search->sizeHint().height() + kGap + entries * rowHeight + frame, screen.height() / 2);
    const int bar = m_list->verticalScrollBar()->sizeHint().width();
    const int width =
        std::clamp(m_list->sizeHintForIndex(m_found->index(0, 0)).width() + bar + frame, this->width(), screen.width());
    QPoint corner = mapToGlobal(QPoint(0, this->height()));
    if (corner.y() + height > screen.bottom()) corner.setY(mapToGlobal(QPoint(0, 0)).y() - height);
    corner.setX(std::clamp(corner.x(), screen.left(), std::max(screen.left(), screen.right() - width)));
    m_popup->setGeometry(QRect(corner, QSize(width, height)));
}

void SearchCombo::search(const QString& text) {
    m_found->search(*model(), text);
    const QModelIndex chosen = m_found->indexOf(currentIndex());
    m_list->setCurrentIndex(chosen.isValid() ? chosen : m_found->index(0, 0));
}

void SearchCombo::choose(const QModelIndex& found) {
    if (!found.isValid()) return;
    const int row = m_found->rowOf(found);
    hidePopup();
    setCurrentIndex(row);
    emit activated(row);
}

void SearchCombo::keyPressEvent(QKeyEvent* event) {
    const QString text = event->text();
    const bool types = !text.isEmpty() && text.front().isPrint() && text != QLatin1String(" ") &&
                       (event->modifiers() & ~(Qt::ShiftModifier | Qt::KeypadModifier)) == Qt::NoModifier;
    if (!types) return QComboBox::keyPressEvent(event);
    showPopup();
    m_search->setText(text);
}

bool SearchCombo::eventFilter(QObject* watched, QEvent* event) {
    if (watched != m_search || event->type() != QEvent::KeyPress) return QComboBox::eventFilter(watched, event);
    auto* key = static_cast<QKeyEvent*>(event);
    const int row = m_list->currentIndex().row();
    const auto moveTo = [this](int to) {
        m_list->setCurrentIndex(m_found->index(std::clamp(to, 0, std::max(0, m_found->rowCount() - 1)), 0));
        return true;
    };
    switch (key->key()) {
        case Qt::Key_Return:
        case Qt::Key_Enter:
            choose(m_list->currentIndex());
            return true;
        case Qt::Key_Escape:
            hidePopup();
            return true;
        case Qt::Key_Up:
            return moveTo(row - 1);
        case Qt::Key_Down:
            return moveTo(row + 1);
        case Qt::Key_PageUp:
            return moveTo(row - kEntries + 1);
        case Qt::Key_PageDown:
            return moveTo(row + kEntries - 1);
        default:
            return false;
    }
}

}  // namespace kdx
