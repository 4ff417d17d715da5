// The tour among links and pipes and in a folder whose name is no text.
#include <gtest/gtest.h>

#include <sys/stat.h>

#include "window/tourtest.h"

namespace kdx::test {
namespace {

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

}  // namespace
}  // namespace kdx::test
