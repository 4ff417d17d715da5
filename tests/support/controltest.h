#pragma once

#include <gtest/gtest.h>

#include <QAbstractButton>
#include <QApplication>
#include <QComboBox>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QScrollBar>
#include <QTimer>
#include <QTimerEvent>

#include <stdexcept>
#include <string>

namespace kdx::test {

/// Looks for controls by the system's names and does with them what a user does.
class ControlTest : public ::testing::Test {
protected:
    /// The window or page whose controls are meant.
    virtual QWidget& root() = 0;

    template <typename Control = QWidget>
    Control* find(const char* name) {
        auto* control = root().template findChild<Control*>(QString::fromLatin1(name));
        if (control == nullptr) throw std::runtime_error(std::string("no control ") + name);
        return control;
    }
    /// Presses a button, an option or a check box as a mouse does: nothing happens when it is disabled.
    void click(const char* name) { find<QAbstractButton>(name)->click(); }
    void type(const char* name, const char* utf8) { find<QLineEdit>(name)->setText(QString::fromUtf8(utf8)); }
    void scroll(const char* name, int value) { find<QScrollBar>(name)->setValue(value); }
    /// Chooses an entry of a drop-down list as a user does.
    void select(const char* name, int index);
    /// Presses and releases a key in a control.
    void press(const char* name, Qt::Key key);
    /// Lets a timer that is running tick once; false when it is not running.
    bool tick(const char* name);

    /// What a label, a button or a text box reads, as UTF-8.
    std::string text(const char* name);
    bool checked(const char* name) { return find<QAbstractButton>(name)->isChecked(); }
    /// What is said of the value that the control shows: "" when it is in force.
    std::string stateOf(const char* name) { return find(name)->property("zustand").toString().toStdString(); }
    /// Whether the control itself may be used, a closed session left aside.
    bool enabled(const char* name);
};

}  // namespace kdx::test
