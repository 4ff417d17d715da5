#pragma once

#include <QGroupBox>
#include <QListWidget>
#include <QTimer>

#include <set>

#include "support/networkinstrument.h"
#include "support/windowtest.h"
#include "ui/clickablelabel.h"

namespace kdx::test {

inline const Lines kNoErrors;
inline const Lines kIllegalValue = {R"(-224,"Illegal parameter value")"};

/// Every control of the pages is used as a user does, over the network and with nothing replaced but the clock and the
/// boxes; a second client of the same instrument reads back what has arrived.
class EverySetting : public WindowTest {
protected:
    ~EverySetting() override { end(); }
    void SetUp() override {
        folder.copyShipped();
        start();
        openSession();
        ASSERT_TRUE(state.InstrumentOnline);
        EXPECT_TRUE(window->windowTitle().startsWith(QString::fromLatin1(sim::kDefaultIdentification)));
        // Before the data set's network goes out those that the coder holds are deleted. It holds none, and the one
        // delete that is sent all the same names nothing.
        EXPECT_EQ(observer.errors(), kIllegalValue);
    }
    void TearDown() override { EXPECT_EQ(observer.errors(), kNoErrors); }

    // What is used is written down.
    void click(const std::string& name) {
        m_used.insert(name);
        ASSERT_TRUE(find(name.c_str())->isEnabled()) << name;
        WindowTest::click(name.c_str());
    }
    void type(const char* name, const char* utf8) {
        m_used.insert(name);
        WindowTest::type(name, utf8);
    }
    void scroll(const char* name, int value) {
        m_used.insert(name);
        WindowTest::scroll(name, value);
    }
    void select(const char* name, int index) {
        m_used.insert(name);
        WindowTest::select(name, index);
    }
    void clickLabel(const char* name) {
        m_used.insert(name);
        emit find<ClickableLabel>(name)->clicked();
    }
    static std::string numbered(const char* name, int index) { return std::string(name) + "_" + std::to_string(index); }

    /// Moves a scroll bar to each value and compares what the instrument then has.
    void expectScroll(const char* name, const char* query, const std::vector<std::pair<int, const char*>>& values) {
        for (const auto& [value, answer] : values) {
            scroll(name, value);
            EXPECT_EQ(observer.ask(query), answer) << name << " at " << value;
        }
        EXPECT_EQ(observer.errors(), kNoErrors) << name;
    }
    /// Chooses the options in turn and compares what the instrument then has.
    void expectOptions(const char* name, const std::string& query, const Lines& answers) {
        for (std::size_t i = 0; i < answers.size(); ++i) {
            click(numbered(name, static_cast<int>(i)));
            EXPECT_EQ(observer.ask(query), answers[i]) << name << " " << i;
        }
        EXPECT_EQ(observer.errors(), kNoErrors) << name;
    }
    /// Turns a switch over and over again.
    void expectSwitch(const char* name, const char* query) {
        const std::string before = observer.ask(query);
        click(name);
        EXPECT_EQ(observer.ask(query), before == "1" ? "0" : "1") << name;
        click(name);
        EXPECT_EQ(observer.ask(query), before) << name;
        EXPECT_EQ(observer.errors(), kNoErrors) << name;
    }
    void expectCoder(const char* name, const std::string& answer) { EXPECT_EQ(observer.askCoder(name), answer); }

    /// Edits a list in the editor's own window, which the button opens: a list of the tuned frequency 99.9 with the
    /// AFs 88.1, 92.0 and 94.<number>.
    void editList(const char* button, int number) {
        dialogs.inputs = {QStringLiteral("99.94")};
        QTimer::singleShot(0, [this, number] {
            auto* editor = QApplication::activeModalWidget();
            ASSERT_NE(editor, nullptr);
            const auto press = [editor](const std::string& name) {
                editor->findChild<QAbstractButton*>(QString::fromStdString(name))->click();
            };
            auto* entry = editor->findChild<QLineEdit*>(QStringLiteral("Text2"));
            auto* list = editor->findChild<QListWidget*>(QStringLiteral("AF_List1"));
            press(numbered("AFList_Opt", number - 1));
            while (list->count() > 0) {
                dialogs.confirmations = {true};
                list->setCurrentRow(0);
                press("Rem_Freq");
            }
            emit editor->findChild<ClickableLabel*>(QStringLiteral("AF_TN"))->clicked();
            for (const std::string& frequency : {std::string("88.1"), "94." + std::to_string(number)}) {
                entry->setText(QString::fromStdString(frequency));
                press("Command1");
            }
            entry->setText(QStringLiteral("92.0"));
            list->setCurrentRow(1);
            press("AF_OF_add");
            press("Uebernahme_Knopf");
        });
        click(button);
    }
    static std::string edited(int number) { return "99.9,88.1,92.0,94." + std::to_string(number); }
    static std::string editedPairs(int number) { return "99.9,99.9,88.1,99.9,92.0,99.9,94." + std::to_string(number); }

    /// Whether every control of the page that a user could change has been used, but for those named.
    void expectAllUsed(int page, const std::set<std::string>& others = {}) {
        const auto* tabs = find<QTabWidget>("SSTab1");
        std::set<std::string> left;
        for (const QWidget* control : tabs->widget(page)->findChildren<QWidget*>()) {
            const bool changes = qobject_cast<const QAbstractButton*>(control) != nullptr ||
                                 qobject_cast<const QScrollBar*>(control) != nullptr ||
                                 qobject_cast<const QComboBox*>(control) != nullptr ||
                                 qobject_cast<const QLineEdit*>(control) != nullptr ||
                                 qobject_cast<const ClickableLabel*>(control) != nullptr;
            const std::string name = control->objectName().toStdString();
            const bool ours = !name.empty() && !name.starts_with("qt_");
            if (changes && ours && !m_used.contains(name)) left.insert(name);
        }
        EXPECT_EQ(left, others);
    }

    Visa& instrumentLink() override { return lan; }

    FakeClock coderClock;  // stands still: the coder answers the very time it was given
    NetworkInstrument instrument{coderClock};
    LanVisa lan{instrument.reachedBy()};
    Observer observer{instrument.reachedBy()};

private:
    std::set<std::string> m_used;
};

}  // namespace kdx::test
