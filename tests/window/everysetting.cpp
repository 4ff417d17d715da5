#include "window/everysetting.h"

#include <QListWidget>

#include "ui/clickablelabel.h"

namespace kdx::test {
namespace {

/// Empties the editor's list, enters another one and takes it over.
void enterList(QWidget& editor, int number, ScriptedDialogs& dialogs) {
    const auto press = [&editor](const std::string& name) {
        editor.findChild<QAbstractButton*>(QString::fromStdString(name))->click();
    };
    auto* entry = editor.findChild<QLineEdit*>(QStringLiteral("Text2"));
    auto* list = editor.findChild<QListWidget*>(QStringLiteral("AF_List1"));
    press("AFList_Opt_" + std::to_string(number - 1));
    while (list->count() > 0) {
        dialogs.confirmations = {true};
        list->setCurrentRow(0);
        press("Rem_Freq");
    }
    emit editor.findChild<ClickableLabel*>(QStringLiteral("AF_TN"))->clicked();
    for (const std::string& frequency : {std::string("88.1"), "94." + std::to_string(number)}) {
        entry->setText(QString::fromStdString(frequency));
        press("Command1");
    }
    entry->setText(QStringLiteral("92.0"));
    list->setCurrentRow(1);
    press("AF_OF_add");
    press("Uebernahme_Knopf");
}

/// Whether a user could change something by the control.
bool changes(const QWidget* control) {
    return qobject_cast<const QAbstractButton*>(control) != nullptr ||
           qobject_cast<const QScrollBar*>(control) != nullptr || qobject_cast<const QComboBox*>(control) != nullptr ||
           qobject_cast<const QLineEdit*>(control) != nullptr ||
           qobject_cast<const ClickableLabel*>(control) != nullptr;
}

}  // namespace

void EverySetting::SetUp() {
    folder.copyShipped();
    start();
    openSession();
    ASSERT_TRUE(state.InstrumentOnline);
    EXPECT_TRUE(window->windowTitle().startsWith(QString::fromLatin1(sim::kDefaultIdentification)));
    // Before the data set's network goes out those that the coder holds are deleted. It holds none, and the one delete
    // that is sent all the same names nothing.
    EXPECT_EQ(observer.errors(), kIllegalValue);
}

void EverySetting::click(const std::string& name) {
    m_used.insert(name);
    ASSERT_TRUE(find(name.c_str())->isEnabled()) << name;
    WindowTest::click(name.c_str());
}

void EverySetting::type(const char* name, const char* utf8) {
    m_used.insert(name);
    WindowTest::type(name, utf8);
}

void EverySetting::scroll(const char* name, int value) {
    m_used.insert(name);
    WindowTest::scroll(name, value);
}

void EverySetting::select(const char* name, int index) {
    m_used.insert(name);
    WindowTest::select(name, index);
}

void EverySetting::clickLabel(const char* name) {
    m_used.insert(name);
    emit find<ClickableLabel>(name)->clicked();
}

void EverySetting::expectScroll(const char* name, const char* query,
                                const std::vector<std::pair<int, const char*>>& values) {
    for (const auto& [value, answer] : values) {
        scroll(name, value);
        EXPECT_EQ(observer.ask(query), answer) << name << " at " << value;
    }
    EXPECT_EQ(observer.errors(), kNoErrors) << name;
}

void EverySetting::expectOptions(const char* name, const std::string& query, const Lines& answers) {
    for (std::size_t i = 0; i < answers.size(); ++i) {
        click(numbered(name, static_cast<int>(i)));
        EXPECT_EQ(observer.ask(query), answers[i]) << name << " " << i;
    }
    EXPECT_EQ(observer.errors(), kNoErrors) << name;
}

void EverySetting::expectSwitch(const char* name, const char* query) {
    const std::string before = observer.ask(query);
    click(name);
    EXPECT_EQ(observer.ask(query), before == "1" ? "0" : "1") << name;
    click(name);
    EXPECT_EQ(observer.ask(query), before) << name;
    EXPECT_EQ(observer.errors(), kNoErrors) << name;
}

void EverySetting::editList(const char* button, int number) {
    dialogs.inputs = {QStringLiteral("99.94")};
    QTimer::singleShot(0, [this, number] {
        auto* editor = QApplication::activeModalWidget();
        ASSERT_NE(editor, nullptr);
        enterList(*editor, number, dialogs);
    });
    click(button);
}

void EverySetting::expectAllUsed(int page, const std::set<std::string>& others) {
    const auto* tabs = find<QTabWidget>("SSTab1");
    std::set<std::string> left;
    for (const QWidget* control : tabs->widget(page)->findChildren<QWidget*>()) {
        const std::string name = control->objectName().toStdString();
        const bool ours = !name.empty() && !name.starts_with("qt_");
        if (changes(control) && ours && !m_used.contains(name)) left.insert(name);
    }
    EXPECT_EQ(left, others);
}

}  // namespace kdx::test
