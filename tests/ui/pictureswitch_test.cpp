#include "ui/pictureswitch.h"

#include <gtest/gtest.h>

#include <QImage>

#include "settings/datafolder.h"
#include "support/tempfolder.h"

namespace kdx {
namespace {

class PictureSwitchTest : public ::testing::Test {
protected:
    PictureSwitchTest() { button.resize(button.sizeHint()); }

    QImage shown(bool on) {
        button.showState(on);
        return button.grab().toImage();
    }

    test::TempFolder folder;
    DataFolder data{folder.path()};
    PictureSwitch button{data, nullptr};
};

TEST_F(PictureSwitchTest, IsCheckedWhileTheOnPictureShows) {
    folder.copyShipped();
    const QImage off = shown(false);
    EXPECT_FALSE(button.isChecked());
    const QImage on = shown(true);
    EXPECT_TRUE(button.isChecked());
    EXPECT_NE(on, off);
}

TEST_F(PictureSwitchTest, AClickAloneChangesNothing) {
    button.showState(false);
    int clicks = 0;
    QObject::connect(&button, &PictureSwitch::clicked, [&clicks] { ++clicks; });
    button.click();
    EXPECT_EQ(clicks, 1);
    EXPECT_FALSE(button.isChecked());
}

TEST_F(PictureSwitchTest, ThePicturesAreLoadedFromTheDataFolderAtEachSwitching) {
    const QImage drawn = shown(true);
    folder.copyShipped();
    EXPECT_NE(shown(true), drawn);
}

TEST_F(PictureSwitchTest, WithoutPicturesTheStateIsStillToBeSeen) {
    EXPECT_NE(shown(true), shown(false));
}

TEST_F(PictureSwitchTest, ABrokenPictureIsReplacedByADrawnOneAndTold) {
    int changes = 0;
    QObject::connect(&button, &PictureSwitch::brokenPictureChanged, [&changes] { ++changes; });
    const QImage drawn = shown(true);
    EXPECT_EQ(button.brokenPicture(), QString()) << "a missing one is no fault";
    folder.write("sch_on.ICO", "no picture at all");
    EXPECT_EQ(shown(true), drawn);
    EXPECT_EQ(button.brokenPicture(), QStringLiteral("Sch_On.ico"));
    EXPECT_EQ(changes, 1);
    std::filesystem::remove(folder.data() / "sch_on.ICO");
    folder.copyShipped();
    EXPECT_EQ(button.grab().toImage(), drawn) << "not looked for at each painting";
    button.tryAgain();
    EXPECT_NE(button.grab().toImage(), drawn);
    EXPECT_EQ(button.brokenPicture(), QString());
    EXPECT_EQ(changes, 2);
}

}  // namespace
}  // namespace kdx
