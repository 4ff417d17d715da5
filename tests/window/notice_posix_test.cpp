// What the quiet line tells of links and pipes in the place of files.
#include <gtest/gtest.h>

#include <sys/stat.h>

#include "window/noticetest.h"

namespace kdx::test {
namespace {

TEST_F(NoticeTest, ALogThatLeadsElsewhereIsToldAlsoWithLoggingOff) {
    const auto thesis = folder.path() / "thesis.txt";
    folder.write("../thesis.txt", "ten years");
    std::filesystem::create_symlink(thesis, folder.data() / kCommandLog);
    setGeneral("ADRESSEN", "Log_Key", "0");
    start();
    EXPECT_EQ(notice(), "Nicht gespeichert: RDS_log.txt");
    EXPECT_EQ(folder.read("../thesis.txt"), "ten years");
    std::filesystem::remove(folder.data() / kCommandLog);
    waitForRetry();
    EXPECT_EQ(notice(), "");
}

TEST_F(NoticeTest, PipesInThePlaceOfFilesDelayNothing) {
    for (const char* file : {kCommandLog, kPictureOn, kPictureOff, kEventList, "Datenset1.INI"}) {
        std::filesystem::remove(folder.data() / file);
        ASSERT_EQ(mkfifo((folder.data() / file).c_str(), 0600), 0);
    }
    start();
    openSession();
    showPage(1);
    QCoreApplication::processEvents();
    EXPECT_NE(notice().find("Nicht lesbar: Datenset1.INI"), std::string::npos) << notice();
    EXPECT_NE(notice().find("Nicht gespeichert: RDS_log.txt"), std::string::npos) << notice();
}

}  // namespace
}  // namespace kdx::test
