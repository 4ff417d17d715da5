#include "rds/storepage.h"

#include "support/pagetest.h"

namespace kdx::test {
namespace {

class StorePageTest : public PageTest {
protected:
    StorePageTest() { page.label(); }
    QWidget& root() override { return page; }
    StorePage page{context, nullptr};
};

TEST_F(StorePageTest, TheThirdButtonStoresInTheThirdMemory) {
    click("Store_Taste_2");
    EXPECT_EQ(sent(), Lines{direct("STORE=3")});
}

TEST_F(StorePageTest, EachButtonStandsForItsOwnMemory) {
    for (int i = 0; i < 5; ++i) {
        click(("Store_Taste_" + std::to_string(i)).c_str());
        EXPECT_EQ(sent(), Lines{direct("STORE=" + std::to_string(i + 1))});
    }
}

TEST_F(StorePageTest, StoringLeavesTheCurrentDataSetAlone) {
    click("Store_Taste_4");
    EXPECT_EQ(state.CurrentDataSet, "1");
    EXPECT_FALSE(std::filesystem::exists(folder.data() / "Datenset1.INI"));
    EXPECT_FALSE(std::filesystem::exists(folder.data() / "Datenset5.INI"));
}

TEST_F(StorePageTest, TheButtonsAreNumberedInEveryLanguage) {
    EXPECT_EQ(text("Store_Taste_0"), "Speichern --> Dataset 1");
    EXPECT_EQ(text("Store_Taste_4"), "Speichern --> Dataset 5");
    useLanguage("english");
    page.label();
    EXPECT_EQ(text("Store_Taste_4"), "Store --> data set 5");
}

}  // namespace
}  // namespace kdx::test
