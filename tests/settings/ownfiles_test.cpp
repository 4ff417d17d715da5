#include "settings/ownfiles.h"

#include <gtest/gtest.h>

#include "datafoldertest.h"

namespace kdx {
namespace {

using OwnFilesTest = DataFolderTest;

TEST_F(OwnFilesTest, TheFilesThatTheProgramKeepsAreItsOwnThereOrNot) {
    for (const char* name : {"RDS_log.txt", "rds_LOG.TXT", "RDS_Allg.INI", "Datenset1.INI", "DATENSET5.ini",
                             "Sprachen.ini", "Event.txt", "Location.txt", "TMC_Liste.txt", "Sch_On.ico"}) {
        EXPECT_TRUE(isOwnFile(m_data, m_folder.data() / name)) << name;
        EXPECT_TRUE(isOwnFile(m_data, m_folder.data() / "x" / ".." / name)) << name;
        EXPECT_FALSE(isOwnFile(m_data, m_folder.path() / name)) << name << " stands elsewhere";
    }
    for (const char* name : {"log.txt", "groups.txt", "Datenset6.INI", "Scenarios/report.txt"})
        EXPECT_FALSE(isOwnFile(m_data, m_folder.data() / name)) << name;
}

}  // namespace
}  // namespace kdx
