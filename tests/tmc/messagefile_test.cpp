// The list of messages is kept in a file of the data folder.
#include "support/listrows.h"
#include "tmcpagetest.h"

namespace kdx::test {
namespace {

class MessageFileTest : public TmcPageTest {};

TEST_F(MessageFileTest, TheMessagesAreKeptOverARestart) {
    addMessages(3);
    list().setCurrentRow(1);
    click("TMC_Gr8_Remove");
    const Lines before = rowsOf(list());
    page = std::make_unique<TmcPage>(context, nullptr);
    page->label();
    page->load();
    EXPECT_EQ(rowsOf(list()), before);
    EXPECT_EQ(before.size(), 2U);
    page->load();  // another data set
    EXPECT_EQ(rowsOf(list()), before);
    EXPECT_EQ(folder.read("TMC_Liste.txt"), before[0] + "\r\n" + before[1] + "\r\n");
}

TEST_F(MessageFileTest, WhatIsNoMessageInTheKeptListIsPassedOver) {
    addMessages(1);
    const Lines before = rowsOf(list());
    folder.write("TMC_Liste.txt", "\r\nnonsense\r\n" + before[0] + "\n" + std::string(5000, 'x'));
    page = std::make_unique<TmcPage>(context, nullptr);
    page->load();
    EXPECT_EQ(rowsOf(list()), before);
}

TEST_F(MessageFileTest, WhatIsNoMessageInTheKeptListStaysThere) {
    folder.write("TMC_Liste.txt", "a note of mine\r\n\xFF\x01;12\n");
    addMessages(1);
    EXPECT_EQ(folder.read("TMC_Liste.txt"), "a note of mine\r\n\xFF\x01;12\r\n" + rowsOf(list())[0] + "\r\n");
}

TEST_F(MessageFileTest, AFolderThatIsOnlyReadStaysSo) {
    folder.write("TMC_Liste.txt", "of the first program\r\n");
    data.setReadOnly();
    dialogs.expectedMessages = 1;
    addMessages(2);
    EXPECT_EQ(folder.read("TMC_Liste.txt"), "of the first program\r\n");
}

TEST_F(MessageFileTest, AListThatCannotBeKeptIsToldOnce) {
    std::filesystem::create_directory(folder.data() / "TMC_Liste.txt");
    dialogs.expectedMessages = 1;
    addMessages(2);
    EXPECT_EQ(list().count(), 2);
    EXPECT_EQ(dialogs.shown.at(0).text, QStringLiteral("TMC_Liste.txt kann nicht gespeichert werden."));
}
}  // namespace
}  // namespace kdx::test
