#include "window/tour.h"

#include <gtest/gtest.h>

#include <QImage>

#include "window/tourtest.h"

namespace kdx::test {
namespace {

TEST_F(TourTest, LeavesNinePicturesAndEveryQuestionAnswered) {
    sim::VirtualInstrument instrument(clock);
    sim::SimVisa visa(instrument);
    EXPECT_EQ(tour(visa), 0) << ::testing::PrintToString(printed);
    for (int page = 0; page < 9; ++page) {
        const auto file = pictures / ("page_" + std::to_string(page) + ".png");
        const QImage picture(QString::fromStdString(file.string()));
        EXPECT_EQ(picture.size(), QSize(640, 480)) << file;
    }
    EXPECT_EQ(printed.back(), "9 pictures, 40 answers, 0 failures");
}

TEST_F(TourTest, PrintsWhatIsSentAndAnswered) {
    sim::VirtualInstrument instrument(clock);
    sim::SimVisa visa(instrument);
    tour(visa);
    EXPECT_EQ(printed.front(), "-> *IDN?");
    EXPECT_NE(std::find(printed.begin(), printed.end(), "-> :STEREO:DIRECT \"PS=MESSTURM\""), printed.end());
    EXPECT_NE(std::find(printed.begin(), printed.end(), "<- \"MESSTURM\""), printed.end());
}

TEST_F(TourTest, AnInstrumentThatDoesNotAnswerIsAFailure) {
    FakeVisa visa;
    EXPECT_EQ(tour(visa), 1);
}

TEST_F(TourTest, AnInstrumentThatIsNotThereIsAFailure) {
    FakeVisa visa;
    visa.openStatus = visa::kResourceNotFound;
    EXPECT_EQ(tour(visa), 1);
    EXPECT_EQ(printed.front(), "!! Interface Error: Please Check Device! -1073807343");
}

TEST_F(TourTest, ASessionOpenedAtTheStartIsClosedBeforeItsOwn) {
    data.WriteIni("BUS", "IECBUS", "AUTO", kGeneralSettings);
    FakeVisa visa;
    tour(visa);
    Lines calls;
    for (const std::string& call : visa.calls) {
        if (call.starts_with("viOpen TCPIP") || call.starts_with("viClose")) calls.push_back(call);
    }
    const std::string open = "viOpen TCPIP::127.0.0.1::INSTR 0 0";
    EXPECT_EQ(calls, (Lines{open, "viClose 102", open, "viClose 104"}));
}

TEST_F(TourTest, EndsEarlyWhenItsWindowIsClosed) {
    sim::VirtualInstrument instrument(clock);
    sim::SimVisa visa(instrument);
    print = [print = print](const std::string& line) {
        print(line);
        if (line != "-> *IDN?") return;
        for (QWidget* top : QApplication::topLevelWidgets()) top->hide();
    };
    EXPECT_EQ(tour(visa), 1);
    EXPECT_TRUE(printed.back().starts_with("0 pictures, ")) << printed.back();
}

TEST_F(TourTest, AFolderThatCannotBeMadeIsAFailure) {
    std::ofstream(folder.path() / "file") << "x";
    pictures = folder.path() / "file" / "pictures";
    sim::VirtualInstrument instrument(clock);
    sim::SimVisa visa(instrument);
    EXPECT_EQ(tour(visa), 1);
}

}  // namespace
}  // namespace kdx::test
