#include "window/tour.h"

#include <gtest/gtest.h>

#include <QImage>

#include "settings/captions.h"
#include "settings/folderlock.h"
#include "sim/simvisa.h"
#include "sim/virtualinstrument.h"
#include "support/windowtest.h"

#include <sys/stat.h>

namespace kdx::test {
namespace {

class TourTest : public ::testing::Test {
protected:
    TourTest() { folder.copyShipped(); }

    int tour(Visa& visa) {
        Session session(visa, state, data, captions, clock, [] {});
        TickerGroup tickers;
        const FolderClaim claim(data.path());
        HMenue window({session, state, data, captions, clock, dialogs, tickers, claim, QString(), QString(), [] {}});
        window.startUp();
        return makeTour(window, session.instrument, dialogs, pictures, print);
    }

    TempFolder folder;
    std::filesystem::path pictures = folder.path() / "pictures";
    DataFolder data{folder.path()};
    FakeClock clock;
    ProgramState state;
    Captions captions{data};
    Lines printed;
    std::function<void(const std::string&)> print = [this](const std::string& line) { printed.push_back(line); };
    TourDialogs dialogs{print};
};

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
    print = [this, print = print](const std::string& line) {
        print(line);
        if (line != "-> *IDN?") return;
        for (QWidget* top : QApplication::topLevelWidgets()) top->hide();
    };
    EXPECT_EQ(tour(visa), 1);
    EXPECT_TRUE(printed.back().starts_with("0 pictures, ")) << printed.back();
}

TEST_F(TourTest, WhatStandsBehindALinkOrAPipeInAPicturesPlaceIsLeftAlone) {
    std::filesystem::create_directories(pictures);
    folder.write("../thesis.txt", "ten years");
    std::filesystem::create_symlink(folder.path() / "thesis.txt", pictures / "page_0.png");
    ASSERT_EQ(mkfifo((pictures / "page_1.png").c_str(), 0600), 0);
    sim::VirtualInstrument instrument(clock);
    sim::SimVisa visa(instrument);
    EXPECT_EQ(tour(visa), 1);
    EXPECT_EQ(folder.read("../thesis.txt"), "ten years");
    EXPECT_EQ(printed.back(), "7 pictures, 40 answers, 2 failures");
}

TEST_F(TourTest, AFolderWhoseNameIsNoUtf8GetsThePictures) {
    pictures = folder.path() / "J\xFCrgen" / "tour";
    sim::VirtualInstrument instrument(clock);
    sim::SimVisa visa(instrument);
    EXPECT_EQ(tour(visa), 0);
    EXPECT_TRUE(std::filesystem::exists(pictures / "page_8.png"));
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
