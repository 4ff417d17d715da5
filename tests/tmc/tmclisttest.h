#pragma once

#include <gtest/gtest.h>

#include <filesystem>
#include <optional>
#include <string>
#include <vector>

#include "support/tempfolder.h"
#include "tmc/tmclist.h"

namespace kdx {

class TmcListTest : public ::testing::Test {
protected:
    [[nodiscard]] std::filesystem::path file() const { return m_folder.data() / "Event.txt"; }
    void write(const std::string& bytes) const { m_folder.write("Event.txt", bytes); }
    [[nodiscard]] std::string content() const { return m_folder.read("Event.txt"); }
    /// What loading the file gives.
    [[nodiscard]] std::optional<std::vector<std::string>> entries() const {
        const std::optional<TmcList> list = loadTmcList(file());
        if (!list) return std::nullopt;
        std::vector<std::string> all;
        for (std::size_t i = 0; i < list->size(); ++i) all.push_back((*list)[i]);
        return all;
    }
    [[nodiscard]] std::ptrdiff_t filesInFolder() const {
        return std::distance(std::filesystem::directory_iterator(m_folder.data()),
                             std::filesystem::directory_iterator());
    }
    test::TempFolder m_folder;
};

}  // namespace kdx
