#include "app/options.h"

#include <gtest/gtest.h>

#include "app/choosevisa.h"
#include "base/clock.h"
#include "sim/virtualinstrument.h"

namespace kdx {
namespace {

TEST(OptionsTest, AreReadInBothForms) {
    const Options options = parseOptions({"--app-folder", "/a", "--tour=/b", "--simulate"});
    EXPECT_EQ(options.error, "");
    EXPECT_EQ(options.appFolder, "/a");
    EXPECT_EQ(options.tourFolder, "/b");
    EXPECT_TRUE(options.simulate);
    EXPECT_FALSE(options.visaLibrary);
}

TEST(OptionsTest, AnUnknownOptionIsNamed) {
    EXPECT_NE(parseOptions({"--colour"}).error.find("--colour"), std::string::npos);
    EXPECT_NE(parseOptions({"file"}).error.find("file"), std::string::npos);
    EXPECT_NE(parseOptions({"-h"}).error, "");
}

TEST(OptionsTest, AMissingOrSuperfluousValueIsNamed) {
    for (const char* wrong : {"--tour", "--app-folder=", "--simulate=yes", "--help=1"}) {
        const std::string name = std::string(wrong).substr(2, std::string(wrong).find('=') - 2);
        EXPECT_NE(parseOptions({wrong}).error.find(name), std::string::npos) << wrong;
    }
}

TEST(OptionsTest, AnEmptyValueIsNoneAndOfAnOptionGivenTwiceTheLastCounts) {
    for (const char* name : {"--tour", "--app-folder", "--visa-library"}) {
        EXPECT_EQ(parseOptions({name, ""}).error, std::string(name) + " needs a value");
    }
    EXPECT_EQ(parseOptions({"--app-folder", "/a", "--app-folder", "/b"}).appFolder, "/b");
}

TEST(OptionsTest, TwoInstrumentsExcludeEachOther) {
    EXPECT_NE(parseOptions({"--simulate", "--visa-library", "x.so"}).error, "");
}

TEST(OptionsTest, TheTourOfTheViewsBelongsToATourOnTheVirtualInstrument) {
    EXPECT_TRUE(parseOptions({"--simulate", "--tour", "/b", "--views"}).views);
    EXPECT_FALSE(parseOptions({"--simulate", "--tour", "/b"}).views);
    EXPECT_NE(parseOptions({"--simulate", "--views"}).error, "");
    EXPECT_NE(parseOptions({"--tour", "/b", "--views"}).error, "") << "its time does not go on by itself";
}

TEST(OptionsTest, TheHelpNamesEveryOption) {
    for (const char* option :
         {"--app-folder", "--visa-library", "--simulate", "--tour", "--views", "--version", "--help"}) {
        EXPECT_NE(helpText().find(option), std::string::npos) << option;
    }
    for (const char* option : {"--app-folder=x", "--visa-library=x", "--tour=x", "--simulate", "--version", "--help"}) {
        EXPECT_EQ(parseOptions({option}).error, "") << option;
    }
}

TEST(ChooseVisaTest, TheVirtualInstrumentAnswersWithoutAnything) {
    SystemClock clock;
    Options options;
    options.simulate = true;
    const ChosenVisa chosen = chooseVisa(options, clock);
    VisaHandle manager = 0;
    VisaHandle session = 0;
    EXPECT_EQ(chosen.visa->viOpenDefaultRM(manager), 0);
    EXPECT_EQ(chosen.visa->viOpen(manager, "TCPIP::127.0.0.1::INSTR", 0, 0, session), 0);
}

TEST(ChooseVisaTest, ALibraryThatWasAskedForIsNotReplacedSilently) {
    const SystemClock clock;
    Options options;
    options.visaLibrary = "/nowhere/libvisa.so";
    const ChosenVisa chosen = chooseVisa(options, clock);
    EXPECT_EQ(chosen.visa, nullptr);
    EXPECT_NE(chosen.description.find("/nowhere/libvisa.so"), std::string::npos);
}

TEST(ChooseVisaTest, SaysHowInstrumentsAreReached) {
    const SystemClock clock;
    const ChosenVisa chosen = chooseVisa({}, clock);
    ASSERT_NE(chosen.visa, nullptr);
    EXPECT_NE(chosen.description, "");
}

}  // namespace
}  // namespace kdx
