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

TEST_F(PictureSwitchTest, ABrokenPictureIsReplacedByADrawnOne) {
    const QImage drawn = shown(true);
    folder.write("sch_on.ICO", "no picture at all");
    EXPECT_EQ(shown(true), drawn);
}

}  // namespace
}  // namespace kdx
