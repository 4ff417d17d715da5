// Data sets that are reached through a link.
#include <gtest/gtest.h>

#include "window/datasetstest.h"

namespace kdx::test {
namespace {

TEST_F(DataSetsTest, AFolderThatIsOnlyReadIsNotWrittenThroughALinkEither) {
    start();
    data.setReadOnly();
    const std::string before = folder.read("Datenset2.INI");
    std::filesystem::create_symlink(folder.data() / "Datenset2.INI", folder.path() / "link.INI");
    std::filesystem::create_directory(folder.data() / "below");
    dialogs.files = {file("link.INI"), file("Daten/below/new.INI"), file("own.INI")};
    dialogs.expectedMessages = 2;
    for (int i = 0; i < 3; ++i) action("Mnu_Datensatz_Sichern_unter")->trigger();
    EXPECT_EQ(folder.read("Datenset2.INI"), before);
    EXPECT_FALSE(std::filesystem::exists(folder.data() / "below" / "new.INI"));
    EXPECT_TRUE(std::filesystem::exists(folder.path() / "own.INI")) << "elsewhere it is the user's own";
}

}  // namespace
}  // namespace kdx::test
