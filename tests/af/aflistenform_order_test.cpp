#include "aflistenformtest.h"

#include <QClipboard>

namespace kdx::test {
namespace {

TEST_F(EditorTest, AfterAddingTheNextFrequencyReplacesTheEntry) {
    open();
    auto* entry = find<QLineEdit>("Text2");
    for (const char* typed : {"90.1", "89.3"}) {
        entry->insert(QString::fromLatin1(typed));  // as the keyboard does: in place of what is selected
        pressEnter("Text2");
        EXPECT_EQ(entry->selectedText().toStdString(), typed);
    }
    EXPECT_EQ(rows(), Lines({"90.1", "94.3", "90.1", "89.3"}));
}

TEST_F(EditorTest, AnAddedFrequencyIsInView) {
    std::string list = "87.6";
    for (int i = 0; i < 60; ++i) list += ",90.1";
    setList("AF_LISTE1", list);
    open();
    QApplication::processEvents();
    auto* shown = find<QListWidget>("AF_List1");
    const auto inView = [&](int row) {
        return shown->viewport()->rect().contains(shown->visualItemRect(shown->item(row)));
    };
    ASSERT_FALSE(inView(shown->count() - 1));
    type("Text2", "99.9");
    click("Command1");
    EXPECT_TRUE(inView(shown->count() - 1));
    selectRow(1);
    shown->scrollToBottom();
    click("AF_OF_add");
    EXPECT_TRUE(inView(1));
}

TEST_F(EditorTest, APastedListBecomesItsFrequencies) {
    open();
    QApplication::clipboard()->setText(QStringLiteral("99.9, 101.5,87.7"));
    find<QLineEdit>("Text2")->clear();
    find<QLineEdit>("Text2")->paste();
    EXPECT_EQ(text("KommaHinweis"), "3 Frequenzen");
    pressEnter("Text2");
    EXPECT_EQ(rows(), Lines({"90.1", "94.3", "99.9", "101.5", "87.7"}));
    selectRow(0);
    click("AF_OF_add");
    EXPECT_EQ(rows(), Lines({"99.9", "101.5", "87.7", "90.1", "94.3", "99.9", "101.5", "87.7"}));
}

TEST_F(EditorTest, ACommaThatSeparatesIsToldAsItIsTyped) {
    open();
    type("Text2", "90.1");
    EXPECT_EQ(text("KommaHinweis"), "");
    type("Text2", "90,1");
    EXPECT_EQ(text("KommaHinweis"), "Ein Komma trennt: Dezimalstellen stehen nach einem Punkt.");
    state.corrections.decimalComma = true;  // then it is a point
    type("Text2", "90,2");
    EXPECT_EQ(text("KommaHinweis"), "");
}

TEST_F(EditorTest, TheHintOfACommaMovesNothing) {
    for (const char* language : {"deutsch", "english", "english US"}) {
        useLanguage(language);
        open();
        QApplication::processEvents();
        const auto places = [this] {
            QApplication::processEvents();
            std::vector<std::pair<QWidget*, QRect>> all{{&*editor, editor->rect()}};
            for (QWidget* control : editor->findChildren<QWidget*>()) {
                if (control->window() == &*editor && control->isVisible())
                    all.emplace_back(control, control->geometry());
            }
            return all;
        };
        type("Text2", "90");
        const auto before = places();
        for (const char* entry : {"90,1", "90.1, 94.3, 100.1"}) {
            type("Text2", entry);
            const auto* hint = find<QLabel>("KommaHinweis");
            EXPECT_FALSE(hint->text().isEmpty()) << entry;
            const auto after = places();
            ASSERT_EQ(after.size(), before.size());
            for (std::size_t i = 0; i < after.size(); ++i) {
                EXPECT_EQ(after[i].second, before[i].second)
                    << language << ' ' << after[i].first->objectName().toStdString();
            }
            EXPECT_LE(hint->heightForWidth(hint->width()), hint->height()) << language << " is cut off";
        }
    }
}

TEST_F(EditorTest, WhatCannotBeTakenIsNamedAndSelected) {
    open();
    auto* entry = find<QLineEdit>("Text2");
    const auto refused = [&](const char* typed) {
        type("Text2", typed);
        entry->deselect();
        dialogs.expectedMessages = 1;
        click("Command1");
        expectRefusal(dialogs.shown.size() - 1, 164);
        return dialogs.shown.back().preset.toStdString();
    };
    EXPECT_EQ(refused("200.1, 90.1"), "Nicht angenommen: 200.1");
    EXPECT_EQ(entry->selectedText().toStdString(), "200.1");
    state.corrections.decimalComma = true;  // then a list is checked to its end
    EXPECT_EQ(refused("100.5, 94.3, 0.5, x"), "Nicht angenommen: 0.5");
    EXPECT_EQ(entry->selectionStart(), 13) << "not the end of the first";
    EXPECT_EQ(entry->selectedText().toStdString(), "0.5");
    EXPECT_EQ(refused("110,5"), "") << "one number";
    EXPECT_EQ(entry->selectedText().toStdString(), "110,5");
    EXPECT_EQ(rows(), Lines({"90.1", "94.3"}));
}

TEST_F(EditorTest, CountsTheFrequencies) {
    open();
    EXPECT_EQ(text("AF_Zaehler"), "2 von 25 (A), 12 (B)");
    for (int i = 3; i <= 26; ++i) {
        type("Text2", "99.9");
        click("Command1");
        EXPECT_EQ(text("AF_Zaehler"), std::to_string(i) + " von 25 (A), 12 (B)");
        EXPECT_EQ(find("AF_Zaehler")->toolTip().contains(QStringLiteral("Methode B")), i > 12) << i;
        EXPECT_EQ(find("AF_Zaehler")->toolTip().contains(QStringLiteral("Mehr Frequenzen")), i > 25) << i;
    }
}

TEST_F(EditorTest, TheOrderCanBeChanged) {
    setList("AF_LISTE1", "87.6,100.1,90.1,94.3");
    open();
    selectRow(0);
    click("AF_Ab");
    EXPECT_EQ(rows(), Lines({"90.1", "100.1", "94.3"}));
    click("AF_Ab");
    click("AF_Ab");  // stands at the end
    EXPECT_EQ(rows(), Lines({"90.1", "94.3", "100.1"}));
    click("AF_Auf");
    EXPECT_EQ(rows(), Lines({"90.1", "100.1", "94.3"}));
    EXPECT_EQ(find<QListWidget>("AF_List1")->currentRow(), 1);
    click("AF_Sortieren");
    EXPECT_EQ(rows(), Lines({"90.1", "94.3", "100.1"}));
    click("Uebernahme_Knopf");
    EXPECT_EQ(profile(kSet1, "RDS", "AF_LISTE1"), "87.6,90.1,94.3,100.1");
}

TEST_F(EditorTest, TheDeleteKeyAsksAsTheButtonDoes) {
    dialogs.confirmations = {false, true};
    open();
    selectRow(0);
    press("AF_List1", Qt::Key_Delete);
    EXPECT_EQ(rows(), Lines({"90.1", "94.3"}));
    press("AF_List1", Qt::Key_Delete);
    EXPECT_EQ(rows(), Lines{"94.3"});
    EXPECT_EQ(dialogs.shown.at(0).title, QStringLiteral("Change List?"));
}

}  // namespace
}  // namespace kdx::test
