#include <gtest/gtest.h>

#include <QClipboard>
#include <QInputDialog>
#include <QListWidget>

#include <algorithm>
#include <ostream>

#include "support/windowtest.h"
#include "ui/clickablelabel.h"
#include "ui/qtdialogs.h"

namespace kdx::test {
namespace {

/// A user who pastes texts that were copied with their line ends, with the real boxes.
class PastingTest : public WindowTest {
protected:
    PastingTest() {
        startShipped();
        openSession();
        sent();
    }
    Dialogs& boxesOfWindow() override { return boxes; }

    static void paste(QLineEdit& entry, const char* text) {
        QGuiApplication::clipboard()->setText(QString::fromLatin1(text));
        entry.clear();
        entry.paste();
    }
    /// Does something with the modal window that opens next.
    static void whenOpen(std::function<void(QWidget& shown)> act) {
        QTimer::singleShot(0, qApp, [act = std::move(act)] {
            QWidget* shown = QApplication::activeModalWidget();
            ASSERT_NE(shown, nullptr);
            act(*shown);
        });
    }
    /// Clicks a label that asks for a text, and answers by pasting.
    static void answerByPasting(ClickableLabel& label, const char* text) {
        whenOpen([text](QWidget& shown) {
            auto& box = dynamic_cast<QInputDialog&>(shown);
            paste(*box.findChild<QLineEdit*>(), text);
            box.accept();
        });
        emit label.clicked();
    }
    void expectNoControlCharacterSent() {
        const Lines commands = sent();
        EXPECT_FALSE(commands.empty());
        for (const std::string& command : commands) {
            for (const char c : command) EXPECT_GE(static_cast<unsigned char>(c), 0x20) << command;
        }
    }

    QtDialogs boxes{captions};
};

struct Entry {
    const char* name;
    const char* send;  ///< the button beside it
    const char* key;   ///< in data set 1
};

void PrintTo(const Entry& entry, std::ostream* out) {
    *out << entry.name;
}

class PastingIntoAnEntry : public PastingTest, public ::testing::WithParamInterface<Entry> {};

TEST_P(PastingIntoAnEntry, SendsAndStoresNoControlCharacter) {
    paste(*find<QLineEdit>(GetParam().name), "A\r\nB\r\n");
    EXPECT_EQ(text(GetParam().name), "A B");
    click(GetParam().send);
    expectNoControlCharacterSent();
    EXPECT_EQ(data.ReadIni("RDS", GetParam().key, dataSetFile("1")), "A B");
}

std::string entryName(const ::testing::TestParamInfo<Entry>& info) {
    std::string name = info.param.name;
    std::erase(name, '_');
    return name;
}

constexpr Entry kEntries[] = {{"PS_T", "PS_Taste", "PS"},
                              {"RT_Text1", "RT_Taste1", "RTA"},
                              {"PI_T", "Command3", "PI"},
                              {"EON_PI_Text", "EON_PI_Taste", "EON_PI"},
                              {"EON_PS_Text", "EON_PS_Taste", "EON_PS"}};

INSTANTIATE_TEST_SUITE_P(Entries, PastingIntoAnEntry, ::testing::ValuesIn(kEntries), entryName);

/// Entries that a data set filled with what nobody can type.
class StoredInAnEntry : public PastingTest, public ::testing::WithParamInterface<Entry> {
protected:
    StoredInAnEntry() {
        setDataSet1("RDS", GetParam().key, "A\tB\x01");
        visa.written.clear();
        start();
    }
};

TEST_P(StoredInAnEntry, GoesAsItIsStoredWithTheWholeDataSet) {
    openSession();
    const Lines commands = sent();
    EXPECT_TRUE(std::any_of(commands.begin(), commands.end(),
                            [](const std::string& command) { return command.find("A\tB\x01") != std::string::npos; }));
    EXPECT_EQ(data.ReadIni("RDS", GetParam().key, dataSetFile("1")), "A\tB\x01");
}

TEST_P(StoredInAnEntry, GoesWithoutControlCharactersByTheButtonBesideIt) {
    openSession();
    visa.written.clear();
    click(GetParam().send);
    expectNoControlCharacterSent();
    // The other network's PI is stored when it is typed only.
    const bool stores = GetParam().key != std::string("EON_PI");
    EXPECT_EQ(data.ReadIni("RDS", GetParam().key, dataSetFile("1")), stores ? "A B" : "A\tB\x01");
}

INSTANTIATE_TEST_SUITE_P(Entries, StoredInAnEntry, ::testing::ValuesIn(kEntries), entryName);

TEST_F(PastingTest, IntoTheMiddleKeepsTheCursorBehindWhatWasPasted) {
    auto* entry = find<QLineEdit>("PS_T");
    entry->setText(QStringLiteral("XY"));
    entry->setCursorPosition(1);
    QGuiApplication::clipboard()->setText(QStringLiteral("A\r\nB\n"));
    entry->paste();
    EXPECT_EQ(text("PS_T"), "XA B Y");
    EXPECT_EQ(entry->cursorPosition(), 5);
}

TEST_F(PastingTest, TheEntriesOfTheTrafficMessages) {
    paste(*find<QLineEdit>("txtCycleTime"), "\t1.5\r\n");
    EXPECT_EQ(text("txtCycleTime"), "1.5");
    paste(*find<QComboBox>("TMC_Var_Combo")->lineEdit(), "3\r\n");
    EXPECT_EQ(text("TMC_Var_Combo"), "3");
    EXPECT_EQ(text("TMCBL3_Extent"), "011");
}

TEST_F(PastingTest, TheAfEditorsEntry) {
    QString appended;
    whenOpen([&appended](QWidget& editor) {
        const auto press = [&editor](const char* name) {
            editor.findChild<QAbstractButton*>(QString::fromLatin1(name))->click();
        };
        paste(*editor.findChild<QLineEdit*>(QStringLiteral("Text2")), "\t90.1\r\n");
        press("Command1");
        const auto* list = editor.findChild<QListWidget*>(QStringLiteral("AF_List1"));
        appended = list->item(list->count() - 1)->text();
        press("Uebernahme_Knopf");
    });
    click("AF_Bearbeiten");
    EXPECT_EQ(appended, QStringLiteral("90.1"));
    EXPECT_TRUE(data.ReadIni("RDS", "AF_LISTE1", dataSetFile("1")).ends_with(",90.1"));
}

TEST_F(PastingTest, TheAddress) {
    answerByPasting(*find<ClickableLabel>("Adr1_Label"), "lab\r\n7\n");
    EXPECT_EQ(text("Adr1_Label"), "lab 7");
    EXPECT_EQ(general("ADRESSEN", "KDX_TCPIP"), "lab 7");
}

TEST_F(PastingTest, TheBoxesOfTheTrafficMessageListEditor) {
    whenOpen([](QWidget& editor) {
        for (const auto& [name, typed] : {std::pair{"Event_Input_TXT", "A\r\nB"}, {"Event_Input_Nr", "17\r\n"}}) {
            answerByPasting(*editor.findChild<ClickableLabel*>(QString::fromLatin1(name)), typed);
        }
        editor.findChild<QAbstractButton*>(QStringLiteral("Event_Hinzu"))->click();
        editor.close();
    });
    action("Mnu_TMC_Edit")->trigger();
    EXPECT_NE(folder.read("Event.txt").find("A B;17"), std::string::npos);
}

}  // namespace
}  // namespace kdx::test
