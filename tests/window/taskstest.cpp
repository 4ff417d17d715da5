#include "window/taskstest.h"

#include <QCheckBox>
#include <QMouseEvent>
#include <QRadioButton>

namespace kdx::test {

void TasksTest::openSession() {
    click("INIT_Taste");
    ASSERT_TRUE(find("SSTab1")->isEnabled());
    ask("SYST:ERR?");  // opening deletes networks, also where there is none
}

void TasksTest::workOn(int page) {
    openSession();
    showPage(page);
    heard = [this](const Traffic& traffic) {
        if (traffic.kind == Traffic::Kind::Written && traffic.text.find('?') == std::string::npos)
            m_got.push_back(traffic.text);
    };
}

void TasksTest::showPage(int page) {
    WindowTest::showPage(page);
    QCoreApplication::processEvents();
}

void TasksTest::click(QWidget& control) {
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

void TasksTest::type(QWidget& entry, const QString& text) {
    ASSERT_TRUE(entry.isVisible() && entry.isEnabled()) << entry.objectName().toStdString();
    const auto key = [&entry](int code, Qt::KeyboardModifiers modifiers, const QString& typed) {
        QKeyEvent event(QEvent::KeyPress, code, modifiers, typed);
        QApplication::sendEvent(&entry, &event);
    };
    key(Qt::Key_A, Qt::ControlModifier, {});
    for (const QChar character : text)
        key(character == QLatin1Char('\n') ? Qt::Key_Return : 0, Qt::NoModifier, character);
}

void TasksTest::choose(const char* entry) {
    ASSERT_TRUE(action(entry)->isEnabled()) << entry;
    action(entry)->trigger();
}

std::string TasksTest::ask(const std::string& message) {
    const std::string answer = instrument.execute(message);
    return answer.substr(0, answer.find('\n'));
}

std::string TasksTest::has(const std::string& name) {
    const std::string answer = ask(coder(name));
    return answer.size() < 2 ? answer : answer.substr(1, answer.size() - 2);
}

}  // namespace kdx::test
