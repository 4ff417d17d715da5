#pragma once

#include <gmock/gmock.h>

#include <QCheckBox>
#include <QMouseEvent>
#include <QRadioButton>
#include <QShortcut>

#include <memory>

#include "link/workervisa.h"
#include "sim/simvisa.h"
#include "sim/virtualinstrument.h"
#include "support/watchedvisa.h"
#include "support/windowtest.h"

namespace kdx::test {

/// The pages by their place.
constexpr int kStereoPage = 0;
constexpr int kRdsPage = 1;
constexpr int kAfPage = 2;
constexpr int kGroupPage = 3;
constexpr int kEonPage = 4;
constexpr int kQueryPage = 5;
constexpr int kStorePage = 6;
constexpr int kTmcPage = 7;
constexpr int kRfPage = 8;

/// A user before the whole window, on the shipped data, with the virtual instrument on the bench: its calls run in a
/// thread of their own as in the program. Only what can be seen and is enabled can be used.
class TasksTest : public WindowTest {
protected:
    void SetUp() override { startShipped(); }
    ~TasksTest() override { end(); }
    Visa& instrumentLink() override { return m_worker; }
    WorkerVisa* worker() override { return &m_worker; }

    void openSession() {
        click("INIT_Taste");
        ASSERT_TRUE(find("SSTab1")->isEnabled());
        ask("SYST:ERR?");  // opening deletes networks, also where there is none
    }
    /// Opens the session and goes to a page.
    void workOn(int page) {
        openSession();
        showPage(page);
        heard = [this](const Traffic& traffic) {
            if (traffic.kind == Traffic::Kind::Written && traffic.text.find('?') == std::string::npos)
                m_got.push_back(traffic.text);
        };
    }

    void showPage(int page) {
        WindowTest::showPage(page);
        QCoreApplication::processEvents();
    }
    void click(QWidget& control) {
        ASSERT_TRUE(control.isVisible() && control.isEnabled()) << control.objectName().toStdString();
        const bool marked =
            qobject_cast<QCheckBox*>(&control) != nullptr || qobject_cast<QRadioButton*>(&control) != nullptr;
        const QPointF at = marked ? QPointF(8, control.height() / 2.0) : QRectF(control.rect()).center();
        for (const auto type : {QEvent::MouseButtonPress, QEvent::MouseButtonRelease}) {
            const bool down = type == QEvent::MouseButtonPress;
            QMouseEvent event(type, at, control.mapToGlobal(at), Qt::LeftButton, down ? Qt::LeftButton : Qt::NoButton,
                              Qt::NoModifier);
            QApplication::sendEvent(&control, &event);
        }
    }
    void click(const char* name) { click(*find(name)); }
    /// Types over what the entry holds; a line end is Return.
    static void type(QWidget& entry, const QString& text) {
        ASSERT_TRUE(entry.isVisible() && entry.isEnabled()) << entry.objectName().toStdString();
        const auto key = [&entry](int code, Qt::KeyboardModifiers modifiers, const QString& typed) {
            QKeyEvent event(QEvent::KeyPress, code, modifiers, typed);
            QApplication::sendEvent(&entry, &event);
        };
        key(Qt::Key_A, Qt::ControlModifier, {});
        for (const QChar character : text)
            key(character == QLatin1Char('\n') ? Qt::Key_Return : 0, Qt::NoModifier, character);
    }
    void type(const char* name, const char* utf8) { type(*find(name), QString::fromUtf8(utf8)); }
    void choose(const char* entry) {
        ASSERT_TRUE(action(entry)->isEnabled()) << entry;
        action(entry)->trigger();
    }

    /// What the generator answers at the bench, without its line end; somebody else may also tell it something.
    std::string ask(const std::string& message) {
        const std::string answer = instrument.execute(message);
        return answer.substr(0, answer.find('\n'));
    }
    /// A value of the coder, without the quotes around it.
    std::string has(const std::string& name) {
        const std::string answer = ask(coder(name));
        return answer.size() < 2 ? answer : answer.substr(1, answer.size() - 2);
    }
    /// The commands that have arrived since the last call.
    Lines got() { return std::exchange(m_got, {}); }
    std::string stateOf(const char* name) { return find(name)->property("zustand").toString().toStdString(); }

    sim::VirtualInstrument instrument{clock};
    sim::SimVisa bench{instrument};
    std::shared_ptr<WatchedVisa> cable = std::make_shared<WatchedVisa>(bench);

private:
    WorkerVisa m_worker{cable};
    Lines m_got;
};

}  // namespace kdx::test
