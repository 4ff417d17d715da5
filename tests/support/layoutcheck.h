#pragma once

#include <gtest/gtest.h>

#include <QAbstractButton>
#include <QCheckBox>
#include <QComboBox>
#include <QGroupBox>
#include <QLabel>
#include <QRadioButton>
#include <QScrollArea>
#include <QStyle>
#include <QStyleOptionGroupBox>
#include <QWidget>

#include "ui/elided.h"

namespace kdx::test {

/// Fails for every visible label, button, combo box and frame below `root` that is smaller than its text needs, and
/// for every control that sticks out of its parent.
inline void expectNothingCutOff(const QWidget& root, const std::string& where) {
    for (const QWidget* widget : root.findChildren<QWidget*>()) {
        if (!widget->isVisible() || widget->size().isEmpty()) continue;
        const auto name = where + ": " + widget->metaObject()->className() + " " + widget->objectName().toStdString();
        QSize need;
        QString text;
        if (const auto* label = qobject_cast<const QLabel*>(widget); label && !label->text().isEmpty()) {
            if (label->sizePolicy().horizontalPolicy() == QSizePolicy::Ignored && !label->wordWrap()) {
                EXPECT_TRUE(visibleText(*label) == label->text() || elidesLongText(*label))
                    << name << " cuts off \"" << label->text().toStdString() << '"';
                continue;
            }
            need = label->wordWrap() ? QSize(0, label->heightForWidth(label->width())) : label->minimumSizeHint();
            text = label->text();
        } else if (const auto* button = qobject_cast<const QAbstractButton*>(widget);
                   button && !button->text().isEmpty()) {
            // The style's own padding may shrink; the text, the mark and a pixel of air on both sides may not.
            const QSize letters = button->fontMetrics().size(Qt::TextShowMnemonic, button->text());
            const bool marked = qobject_cast<const QRadioButton*>(button) || qobject_cast<const QCheckBox*>(button);
            need = marked ? button->minimumSizeHint() : letters + QSize(4, 2);
            text = button->text();
        } else if (const auto* frame = qobject_cast<const QGroupBox*>(widget); frame && !frame->title().isEmpty()) {
            need = QSize(frame->fontMetrics().size(Qt::TextShowMnemonic, frame->title()).width() + 8, 0);
            text = frame->title();
        } else if (const auto* combo = qobject_cast<const QComboBox*>(widget)) {
            need = QSize(combo->fontMetrics().horizontalAdvance(combo->currentText()) + 20, 0);
            text = combo->currentText();
        }
        EXPECT_GE(widget->width(), need.width()) << name << " cuts off \"" << text.toStdString() << '"';
        EXPECT_GE(widget->height(), need.height()) << name << " cuts off \"" << text.toStdString() << '"';
        const QWidget* parent = widget->parentWidget();
        if (const auto* area = parent ? qobject_cast<const QScrollArea*>(parent->parentWidget()) : nullptr;
            area && area->widget() == widget) {
            EXPECT_LE(widget->width(), parent->width()) << name << " would have to be scrolled to the side";
        } else if (parent && !widget->isWindow()) {
            EXPECT_TRUE(parent->rect().contains(widget->geometry())) << name << " sticks out of its parent";
        }
    }
}

}  // namespace kdx::test
