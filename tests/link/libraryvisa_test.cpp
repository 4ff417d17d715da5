#include "link/libraryvisa.h"

#include "base/paths.h"
#include "link/sharedlibrary.h"

#include "support/tempfolder.h"

#include <gmock/gmock.h>

#include <filesystem>
#include <string>
#include <vector>

namespace kdx {
namespace {

using ::testing::AllOf;
using ::testing::ElementsAre;
using ::testing::HasSubstr;
using ::testing::IsEmpty;
using ::testing::Not;
using ::testing::StartsWith;

const std::string kComplete = KDX_FAKE_VISA;
const std::string kIncomplete = KDX_FAKE_VISA_INCOMPLETE;
const std::string kWide = KDX_FAKE_VISA_WIDE;
const std::string kWordless = KDX_FAKE_VISA_WORDLESS;

/// A session to the library's instrument.
class LibraryVisaTest : public ::testing::Test {
protected:
    explicit LibraryVisaTest(const std::string& file = kComplete) : library(loadVisaLibrary(file)) {}
    void SetUp() override {
        ASSERT_NE(library.visa, nullptr) << library.reason;
        ASSERT_EQ(library.visa->viOpenDefaultRM(manager), 0);
        ASSERT_EQ(library.visa->viOpen(manager, "GPIB0::28::INSTR", 0, 0, session), 0);
    }
    std::string read(std::size_t size = 60) {
        std::string buffer(size, ' ');
        status = library.visa->viRead(session, buffer, count);
        return buffer;
    }

    VisaLibrary library;
    VisaHandle manager = 0;
    VisaHandle session = 0;
    VisaStatus status = 0;
    std::int32_t count = -1;
};

TEST_F(LibraryVisaTest, TellsWhichFileWasLoaded) {
    EXPECT_TRUE(std::filesystem::equivalent(library.file, kComplete));
    EXPECT_EQ(library.reason, "");
}

TEST_F(LibraryVisaTest, OpensWithTheArgumentsAsTheyStand) {
    ASSERT_EQ(library.visa->viOpen(manager, "TCPIP:: x ::INSTR", 1, 2500, session), 0);
    EXPECT_THAT(read(), StartsWith("TCPIP:: x ::INSTR 1 2500"));
}

TEST(LibraryVisaList, NamesTheInstrumentsThatTheLibraryKnows) {
    for (const std::string& file : {kComplete, kWide}) {
        EXPECT_THAT(loadVisaLibrary(file).visa->findResources(),
                    ElementsAre("GPIB0::28::INSTR", "ASRL1::INSTR", "TCPIP0::127.0.0.1::inst0::INSTR"));
    }
}

TEST(LibraryVisaList, IsEmptyWhereTheLibraryCannotSay) {
    EXPECT_THAT(loadVisaLibrary(kWordless).visa->findResources(), IsEmpty());
}

TEST(LibraryVisaTime, IsSetForEachSession) {
    using namespace std::chrono_literals;
    for (const std::string& file : {kComplete, kWide}) {
        const VisaLibrary library = loadVisaLibrary(file, 2500ms);
        ASSERT_NE(library.visa, nullptr) << library.reason;
        VisaHandle manager = 0, session = 0;
        library.visa->viOpenDefaultRM(manager);
        ASSERT_EQ(library.visa->viOpen(manager, "GPIB0::28::INSTR", 0, 0, session), 0);
        std::string answer(60, ' ');
        std::int32_t count = 0;
        library.visa->viRead(session, answer, count);
        EXPECT_THAT(answer, StartsWith("GPIB0::28::INSTR 0 0 1073676314=2500 "));
    }
}

TEST(LibraryVisaTime, ThatTheLibraryDoesNotTakeIsAFailedOpening) {
    using namespace std::chrono_literals;
    const VisaLibrary library = loadVisaLibrary(kComplete, 6667ms);
    VisaHandle manager = 0, session = 0;
    library.visa->viOpenDefaultRM(manager);
    EXPECT_EQ(library.visa->viOpen(manager, "GPIB0::28::INSTR", 0, 0, session), visa::kInvalidObject);
}

TEST(LibraryVisaTime, NeedsALibraryThatCanSetIt) {
    EXPECT_NE(loadVisaLibrary(kWordless).visa, nullptr);
    EXPECT_THAT(loadVisaLibrary(kWordless, std::chrono::milliseconds(100)).reason, HasSubstr("lacks viSetAttribute"));
}

TEST_F(LibraryVisaTest, StatusesOfAllKindsComeThrough) {
    EXPECT_EQ(library.visa->viOpen(manager, "STATUS -1073807343", 0, 0, session), -1073807343);
    EXPECT_EQ(library.visa->viOpen(manager, "STATUS 1073676413", 0, 0, session), 1073676413);
    const std::string failing = "STATUS -1073807339";
    EXPECT_EQ(library.visa->viWrite(session, failing, count), -1073807339);
    EXPECT_EQ(count, 0);
    const std::string warning = "STATUS 1073676294";
    EXPECT_EQ(library.visa->viWrite(session, warning, count), 1073676294);
    EXPECT_EQ(count, 17);
    std::string text;
    EXPECT_EQ(library.visa->viStatusDesc(manager, 7, text), 1073676421);
}

TEST_F(LibraryVisaTest, BytesAreWrittenAndReadAsTheyStand) {
    std::string all;
    for (int c = 0; c < 256; ++c) all += static_cast<char>(c);
    EXPECT_EQ(library.visa->viWrite(session, all, count), 0);
    EXPECT_EQ(count, 256);
    EXPECT_EQ(read(256), all);
    EXPECT_EQ(status, 0);
    EXPECT_EQ(count, 256);
}

TEST_F(LibraryVisaTest, AReadFillsNoMoreThanTheBuffer) {
    const std::string answer(61, 'x');
    library.visa->viWrite(session, answer, count);
    EXPECT_EQ(read(), std::string(60, 'x'));
    EXPECT_EQ(status, 1073676294);
    EXPECT_EQ(count, 60);
    EXPECT_EQ(read(), "x" + std::string(59, ' '));
    EXPECT_EQ(status, 0);
    EXPECT_EQ(count, 1);
}

TEST_F(LibraryVisaTest, DescribesStatusesInTheLibrarysWords) {
    std::string text;
    EXPECT_EQ(library.visa->viStatusDesc(manager, -1073807339, text), 0);
    EXPECT_EQ(text, "status -1073807339 of 2147483649");
}

TEST_F(LibraryVisaTest, ClosesWhatItIsTold) {
    EXPECT_EQ(library.visa->viClose(session), 0);
    EXPECT_EQ(library.visa->viClose(manager), 0);
    EXPECT_EQ(library.visa->viClose(5), -1073807346);
}

TEST_F(LibraryVisaTest, AWrongSessionIsTheLibrarysAffair) {
    session = 5;
    read();
    EXPECT_EQ(status, -1073807346);
    EXPECT_EQ(count, 0);
}

class WideLibraryVisaTest : public LibraryVisaTest {
protected:
    WideLibraryVisaTest() : LibraryVisaTest(kWide) {}
};

// Beside the variables lie others, which eight bytes written over four would fall on.
TEST_F(WideLibraryVisaTest, NumbersOfEightBytesFallOnNothingElse) {
    struct {
        VisaHandle handle = 0;
        VisaHandle beside = 4711;
    } opened;
    EXPECT_EQ(library.visa->viOpenDefaultRM(opened.handle), 0);
    EXPECT_EQ(opened.beside, 4711);
    EXPECT_EQ(library.visa->viOpen(opened.handle, "GPIB0::28::INSTR", 0, 0, opened.handle), 0);
    EXPECT_EQ(opened.beside, 4711);
    EXPECT_EQ(opened.handle, session);
    EXPECT_THAT(read(), StartsWith("GPIB0::28::INSTR 0 0"));
    EXPECT_EQ(status, 0);
    EXPECT_EQ(count, 20);
    const std::string command = "*IDN?";
    EXPECT_EQ(library.visa->viWrite(session, command, count), 0);
    EXPECT_EQ(count, 5);
    std::string text;
    EXPECT_EQ(library.visa->viStatusDesc(manager, -1073807339, text), 0);
    EXPECT_EQ(text, "status -1073807339 of 2147483649");
    EXPECT_EQ(library.visa->viClose(session), 0);
}

TEST(VisaLibrary, WithoutDescriptionsOfStatusesOursStandIn) {
    const VisaLibrary library = loadVisaLibrary(kWordless);
    ASSERT_NE(library.visa, nullptr) << library.reason;
    std::string text;
    EXPECT_EQ(library.visa->viStatusDesc(0, -1073807339, text), 0);
    EXPECT_THAT(text, HasSubstr("time-out"));
    EXPECT_EQ(library.visa->viStatusDesc(0, 7, text), 1073676421);
}

TEST(VisaLibrarySearch, AMissingFileIsNamed) {
    const VisaLibrary library = loadVisaLibrary("/nowhere/libnone.so");
    EXPECT_EQ(library.visa, nullptr);
    EXPECT_EQ(library.file, "");
    EXPECT_THAT(library.reason, StartsWith("/nowhere/libnone.so: "));
}

TEST(VisaLibrarySearch, AFileThatIsNoLibraryIsNamed) {
    const test::TempFolder folder;
    folder.write("libvisa.so", "[BUS]\r\nINTERFACE=TCPIP\r\n");
    const std::string path = utf8Of(folder.data() / "libvisa.so");
    const VisaLibrary library = loadVisaLibrary(path);
    EXPECT_EQ(library.visa, nullptr);
    EXPECT_THAT(library.reason, StartsWith(path + ": "));
}

TEST(VisaLibrarySearch, AnEmptyFileAndAFolderAreNoLibraries) {
    const test::TempFolder folder;
    folder.write("libvisa.so", "");
    EXPECT_EQ(loadVisaLibrary(utf8Of(folder.data() / "libvisa.so")).visa, nullptr);
    const VisaLibrary library = loadVisaLibrary(utf8Of(folder.data()));
    EXPECT_EQ(library.visa, nullptr);
    EXPECT_NE(library.reason, "");
}

TEST(VisaLibrarySearch, ALibraryThatLacksOperationsIsRefusedAndTheyAreNamed) {
    const VisaLibrary library = loadVisaLibrary(kIncomplete);
    EXPECT_EQ(library.visa, nullptr);
    EXPECT_EQ(library.file, "");
    const std::string whole = utf8Of(std::filesystem::absolute(kIncomplete));  // as Windows writes it
    EXPECT_THAT(library.reason, AllOf(StartsWith(whole + ": "), HasSubstr("viClose, viRead")));
    EXPECT_THAT(library.reason, Not(HasSubstr("viWrite")));
}

TEST(VisaLibrarySearch, ABareNameOfAFileThatIsThereMeansThatFile) {
    const std::filesystem::path before = std::filesystem::current_path();
    std::filesystem::current_path(std::filesystem::path(kComplete).parent_path());
    const VisaLibrary library = loadVisaLibrary(utf8Of(pathFromUtf8(kComplete).filename()));
    std::filesystem::current_path(before);
    EXPECT_NE(library.visa, nullptr) << library.reason;
}

TEST(VisaLibrarySearch, NamesAreTriedInTurnAndTheFirstThatWillDoIsTaken) {
    const std::vector<std::string> names = {"/nowhere/a.so", kIncomplete, kComplete, "/nowhere/b.so"};
    const VisaLibrary library = loadFirstVisaLibrary(names);
    ASSERT_NE(library.visa, nullptr);
    EXPECT_TRUE(std::filesystem::equivalent(library.file, kComplete));
    EXPECT_THAT(library.reason, AllOf(HasSubstr("/nowhere/a.so: "), HasSubstr("\n" + kIncomplete + ": "),
                                      Not(HasSubstr("/nowhere/b.so"))));
}

TEST(VisaLibrarySearch, WithoutAnyLibraryEveryNameHasItsCause) {
    const std::vector<std::string> names = {"libkdx-none.so", "libkdx-none.so.0"};
    const VisaLibrary library = loadFirstVisaLibrary(names);
    EXPECT_EQ(library.visa, nullptr);
    EXPECT_THAT(library.reason, AllOf(StartsWith("libkdx-none.so: "), HasSubstr("\nlibkdx-none.so.0: ")));
}

TEST(VisaLibrarySearch, WithoutAPathTheUsualNamesAreTried) {
    const VisaLibrary usual = loadVisaLibrary("");
    if (usual.visa) {
        EXPECT_NE(usual.file, "");  // this computer has one
    } else {
        for (const std::string& name : usualVisaLibraryNames()) EXPECT_THAT(usual.reason, HasSubstr(name + ": "));
    }
}

}  // namespace
}  // namespace kdx
