#include "scenario/report.h"

#include <gtest/gtest.h>

#include "scenario/playtest.h"

namespace kdx::test {
namespace {

using ReportTest = PlayTest;
using scenario::Report;

TEST_F(ReportTest, AFieldIsQuotedWhereItMustBe) {
    EXPECT_EQ(scenario::csvLine({"t", "1", "RT", "a,b", ":STEREO:DIRECT \"RT=a\"", "", "x\r\ny"}),
              "t,1,RT,\"a,b\",\":STEREO:DIRECT \"\"RT=a\"\"\",,\"x\r\ny\"\r\n");
}

TEST_F(ReportTest, TheTimeHasItsDay) {
    clock.set(86'399.9996);
    EXPECT_EQ(scenario::dateAndTime(clock), "2009-03-05 23:59:59.999");
    clock.set(61.05);
    EXPECT_EQ(scenario::dateAndTime(clock), "2009-03-05 00:01:01.050");
}

TEST_F(ReportTest, EveryRowIsInTheFileWhenTheNextThingHappens) {
    const Report file(folder.data() / "report.csv");
    report = &file;
    folder.write("report.csv", "time,step,key,value,command,status,answer\r\nof the last run");
    ASSERT_EQ(file.begin(), std::nullopt);
    EXPECT_EQ(folder.read("report.csv"), "time,step,key,value,command,status,answer\r\n");
    clock.set(36000);
    play("steps: [send: {PS: Süd}, note: \"a, b\"]");
    EXPECT_EQ(folder.read("report.csv"),
              "time,step,key,value,command,status,answer\r\n"
              "2009-03-05 10:00:00.050,1,PS,Süd,\":STEREO:DIRECT \"\"PS=Süd     \"\"\",0,\r\n"
              "2009-03-05 10:00:00.050,2,note,\"a, b\",,,\r\n");
}

TEST_F(ReportTest, AFileThatIsNoReportStaysAsItIs) {
    for (const char* text : {"[RDS]\r\nPS=RADIO\r\n", "x", "time,step,key,value,command,status,answer"}) {
        folder.write("Datenset3.INI", text);
        EXPECT_EQ(Report(folder.data() / "Datenset3.INI").begin(), scenario::ReportFault::Foreign);
        EXPECT_EQ(folder.read("Datenset3.INI"), text);
    }
    folder.write("Datenset3.INI", "");
    EXPECT_EQ(Report(folder.data() / "Datenset3.INI").begin(), std::nullopt);
}

}  // namespace
}  // namespace kdx::test
