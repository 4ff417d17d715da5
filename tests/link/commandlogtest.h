#pragma once

#include <gtest/gtest.h>

#include <filesystem>

#include "link/commandlog.h"
#include "settings/datafolder.h"
#include "support/tempfolder.h"

namespace kdx {

class CommandLogTest : public ::testing::Test {
protected:
    CommandLogTest() {
        m_log.onChange([this] { ++m_changes; });
    }
    [[nodiscard]] std::filesystem::path place() const { return m_folder.data() / kCommandLog; }
    void writeAndEmpty() {
        m_log.empty();
        m_log.append("PS= 1");
    }

    test::TempFolder m_folder;
    DataFolder m_data{m_folder.path()};
    CommandLog m_log{m_data};
    int m_changes = 0;
};

}  // namespace kdx
