#include <QAbstractItemView>

#include "tmcpagetest.h"

namespace kdx::test {
namespace {

class SearchComboTest : public TmcPageTest {
protected:
    SearchComboTest() {
        folder.write("Event.txt",
                     "Stau;00101\r\nstockender Verkehr;00115\r\nUnfall mit Stau;00209\r\nGlatteis;01015\r\n");
        page->reloadLists();
        page->show();
    }
    /// A key in the closed box, as typed.
    void typeInto(const char* name, const QString& text) {
        QKeyEvent event(QEvent::KeyPress, Qt::Key_A, Qt::NoModifier, text);
        QApplication::sendEvent(find(name), &event);
    }
    Lines found() {
        const auto* list = find<QAbstractItemView>("TMC_Event_Combo_Treffer");
        Lines rows;
        for (int row = 0; row < list->model()->rowCount(); ++row) {
            rows.push_back(
                list->model()->index(row, 0).data().toString().section(QLatin1Char(' '), 0, 0).toStdString());
        }
        return rows;
    }
};

TEST_F(SearchComboTest, FindsEntriesByAnyPartOfTheirWords) {
    find<QComboBox>("TMC_Event_Combo")->showPopup();
    EXPECT_EQ(found().size(), 4U);
    type("TMC_Event_Combo_Suche", "STAU");
    EXPECT_EQ(found(), (Lines{"Stau", "Unfall"}));
    type("TMC_Event_Combo_Suche", "stau fall");
    EXPECT_EQ(found(), Lines{"Unfall"});
    type("TMC_Event_Combo_Suche", "nirgends");
    EXPECT_EQ(found(), Lines{});
}

TEST_F(SearchComboTest, WhatBeginsWithTheTextComesFirst) {
    folder.write("Event.txt", "Restaurant offen;00001\r\nStau;00101\r\n");
    page->reloadLists();
    find<QComboBox>("TMC_Event_Combo")->showPopup();
    type("TMC_Event_Combo_Suche", "stau");
    EXPECT_EQ(found(), (Lines{"Stau", "Restaurant"}));
}

TEST_F(SearchComboTest, FindsEntriesByTheirCodes) {
    find<QComboBox>("TMC_Event_Combo")->showPopup();
    type("TMC_Event_Combo_Suche", "1015");
    EXPECT_EQ(found(), Lines{"Glatteis"});
}

TEST_F(SearchComboTest, TypingInTheClosedBoxBeginsTheSearch) {
    typeInto("TMC_Event_Combo", QStringLiteral("g"));
    EXPECT_TRUE(find("TMC_Event_Combo_Treffer")->isVisible());
    EXPECT_EQ(text("TMC_Event_Combo_Suche"), "g");
    EXPECT_EQ(found(), Lines{"Glatteis"});
}

TEST_F(SearchComboTest, ReturnTakesTheEntryAsAClickDoes) {
    find<QComboBox>("TMC_Event_Combo")->showPopup();
    type("TMC_Event_Combo_Suche", "stau");
    press("TMC_Event_Combo_Suche", Qt::Key_Down);
    press("TMC_Event_Combo_Suche", Qt::Key_Return);
    EXPECT_FALSE(find("TMC_Event_Combo_Treffer")->isVisible());
    EXPECT_EQ(find<QComboBox>("TMC_Event_Combo")->currentIndex(), 2);
    EXPECT_EQ(text("TMC_Event_Hex_Label"), "D1");
}

TEST_F(SearchComboTest, EscapeKeepsWhatWasChosen) {
    select("TMC_Event_Combo", 3);
    find<QComboBox>("TMC_Event_Combo")->showPopup();
    type("TMC_Event_Combo_Suche", "stau");
    press("TMC_Event_Combo_Suche", Qt::Key_Escape);
    EXPECT_FALSE(find("TMC_Event_Combo_Treffer")->isVisible());
    EXPECT_EQ(find<QComboBox>("TMC_Event_Combo")->currentIndex(), 3);
}

TEST_F(SearchComboTest, ReturnTakesNothingWhereNothingIsFound) {
    find<QComboBox>("TMC_Event_Combo")->showPopup();
    type("TMC_Event_Combo_Suche", "nirgends");
    press("TMC_Event_Combo_Suche", Qt::Key_Return);
    EXPECT_EQ(find<QComboBox>("TMC_Event_Combo")->currentIndex(), -1);
}

TEST_F(SearchComboTest, ManyHitsAreCutOff) {
    std::string lines;
    for (int i = 0; i < 100'000; ++i) lines += "Ort;" + std::to_string(i) + "\r\n";
    folder.write("Event.txt", lines);
    page->reloadLists();
    find<QComboBox>("TMC_Event_Combo")->showPopup();
    EXPECT_EQ(found().size(), 100'000U);
    type("TMC_Event_Combo_Suche", "ort");
    EXPECT_EQ(found().size(), 1000U);
}

TEST_F(SearchComboTest, SpeaksTheLanguageOfTheWindow) {
    EXPECT_EQ(find<QLineEdit>("TMC_Event_Combo_Suche")->placeholderText(),
              QStringLiteral("Suchen: Teil des Wortes oder Code"));
    useLanguage("english");
    page->label();
    EXPECT_EQ(find<QLineEdit>("TMC_Event_Combo_Suche")->placeholderText(),
              QStringLiteral("Search: part of the word, or code"));
}

}  // namespace
}  // namespace kdx::test
