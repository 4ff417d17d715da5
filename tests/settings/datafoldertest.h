#pragma once

#include <gtest/gtest.h>

#include "settings/datafolder.h"
#include "support/tempfolder.h"

namespace kdx {

class DataFolderTest : public ::testing::Test {
protected:
    test::TempFolder m_folder;
    DataFolder m_data{m_folder.path()};
};

}  // namespace kdx
