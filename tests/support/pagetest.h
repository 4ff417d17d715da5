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

#include <string>

#include "settings/profilefile.h"
#include "support/linkfixture.h"
#include "support/scripteddialogs.h"
#include "ui/keymarks.h"
#include "ui/pagecontext.h"
#include "ui/statusrow.h"
#include "ui/text.h"
#include "ui/ticker.h"

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
    void select(const char* name, int index) {
        auto* combo = find<QComboBox>(name);
        combo->setCurrentIndex(index);
        emit combo->activated(index);
    }
    /// What a label, a button or a text box reads, as UTF-8.
    std::string text(const char* name) {
        if (auto* label = root().findChild<QLabel*>(QString::fromLatin1(name))) return label->text().toStdString();
        if (auto* box = root().findChild<QLineEdit*>(QString::fromLatin1(name))) return box->text().toStdString();
        if (auto* combo = root().findChild<QComboBox*>(QString::fromLatin1(name))) {
            return combo->currentText().toStdString();
        }
        return find<QAbstractButton>(name)->text().toStdString();
    }
    /// Presses and releases a key in a control.
    void press(const char* name, Qt::Key key) {
        for (const auto type : {QEvent::KeyPress, QEvent::KeyRelease}) {
            QKeyEvent event(type, key, Qt::NoModifier);
            QApplication::sendEvent(find(name), &event);
        }
    }
    bool checked(const char* name) { return find<QAbstractButton>(name)->isChecked(); }
    /// What is said of the value that the control shows: "" when it is in force.
    std::string stateOf(const char* name) { return find(name)->property("zustand").toString().toStdString(); }
    /// Whether the control itself may be used, a closed session left aside.
    bool enabled(const char* name) {
        auto* control = find(name);
        return control->isEnabledTo(control->parentWidget());
    }
    /// Lets a timer that is running tick once; false when it is not running.
    bool tick(const char* name) {
        auto* timer = find<QTimer>(name);
        if (!timer->isActive()) return false;
        QTimerEvent event(timer->timerId());
        QApplication::sendEvent(timer, &event);
        return true;
    }
};

/// A page on its own with everything it works with: scripted instrument and boxes, a clock that stands still, a data
/// folder with the shipped texts and otherwise empty profile files. The session counts as open.
class PageTest : public ControlTest, protected LinkFixture {
protected:
    PageTest() {
        const auto languages = sourceFolder() / "Daten" / kLanguageFile;
        std::filesystem::copy_file(languages, folder.data() / kLanguageFile);
        instrument.onFailure([this](const std::string& text, bool sequenceRuns) {
            const QString title = QStringLiteral("Interface Error");
            if (sequenceRuns) return dialogs.messageOrStop(title, toText(text));
            dialogs.message(Dialogs::Icon::Critical, title, toText(text));
            return false;
        });
        state.InstrumentOnline = true;
        state.shownClock = "12:00:00";
        useLanguage("deutsch");
    }

    void useLanguage(const std::string& language, const std::string& standard = "RDS") {
        state.language = language;
        state.standard = standard;
        captions.load(language, standard);
    }
    std::string status(StatusSlot slot) const { return statusRow.text(slot).toStdString(); }
    std::string stateOf(StatusSlot slot) const {
        const auto name = QStringLiteral("Status_%1").arg(static_cast<int>(slot));
        return statusRow.findChild<QLabel*>(name)->property("zustand").toString().toStdString();
    }
    using ControlTest::stateOf;
    /// What is done while the instrument does not answer: one command, whose box is closed.
    void inVain(const std::function<void()>& action) {
        visa.writeStatus = visa::kTimeout;
        dialogs.expectedMessages = 1;
        action();
        EXPECT_EQ(dialogs.expectedMessages, 0) << "nothing was sent";
        visa.writeStatus = 0;
    }

    StatusRow statusRow{nullptr};
    ScriptedDialogs dialogs;
    TickerGroup tickers;
    KeyMarks marks{params, instrument, state, captions};
    PageContext context{params, instrument, settings, state, statusRow, captions, dialogs, data, clock, tickers, marks};
};

}  // namespace kdx::test
