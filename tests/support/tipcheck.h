#pragma once

#include <gtest/gtest.h>

#include <QAbstractItemView>
#include <QAbstractSpinBox>
#include <QComboBox>
#include <QLineEdit>
#include <QScrollArea>
#include <QTabBar>
#include <QTabWidget>
#include <QTableWidget>
#include <QTextEdit>
#include <QWidget>

#include <set>
#include <string>

#include "ui/caption.h"
#include "ui/clickablelabel.h"

namespace kdx::test {

/// Whether the widget belongs to one that is a control itself: the field of a spin box, the bar of a list.
inline bool isPartOfControl(const QWidget& widget) {
    if (widget.objectName().startsWith(QStringLiteral("qt_")) || widget.window()->windowType() == Qt::Popup)
        return true;
    const QWidget* parent = widget.parentWidget();
    return parent != nullptr &&
           (qobject_cast<const QComboBox*>(parent) != nullptr || qobject_cast<const QAbstractSpinBox*>(parent) ||
            qobject_cast<const QLineEdit*>(parent) != nullptr || qobject_cast<const QAbstractScrollArea*>(parent) ||
            qobject_cast<const QTabBar*>(parent) != nullptr || qobject_cast<const QTabWidget*>(parent) != nullptr);
}

/// Whether it takes the focus only to be read or scrolled: texts, frames with a bar, tables of the radio.
inline bool onlyShows(const QWidget& widget) {
    const bool label = qobject_cast<const QLabel*>(&widget) != nullptr;
    return (label && qobject_cast<const ClickableLabel*>(&widget) == nullptr) ||
           qobject_cast<const QScrollArea*>(&widget) != nullptr ||
           qobject_cast<const QTabWidget*>(&widget) != nullptr || qobject_cast<const QTextEdit*>(&widget) != nullptr ||
           (qobject_cast<const QTableWidget*>(&widget) != nullptr &&
            widget.objectName().startsWith(QStringLiteral("Air_")));
}

/// Fails for every control below the window that has no tip, or one that only repeats its caption; views and editors
/// that belong to the window count as below it.
/// @returns the names of the controls that were looked at.
inline std::set<std::string> expectATipOnEveryControl(const QWidget& window, const std::string& where) {
    std::set<std::string> found;
    for (const QWidget* control : window.findChildren<QWidget*>()) {
        if (control->focusPolicy() == Qt::NoFocus || isPartOfControl(*control) || onlyShows(*control)) continue;
        const std::string name = control->objectName().toStdString();
        const std::string what = where + ": " + control->metaObject()->className();
        EXPECT_FALSE(control->toolTip().isEmpty()) << what << ' ' << name;
        EXPECT_NE(control->toolTip(), shownText(control).remove(QLatin1Char('&'))) << what << ' ' << name;
        found.insert(name);
    }
    return found;
}

}  // namespace kdx::test
