// What the operating system's private-profile functions were seen to do, replayed on our reader and writer.
#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <nlohmann/json.hpp>
#include <ostream>
#include <stdexcept>

#include "base/codepage.h"
#include "settings/datafolder.h"
#include "settings/profilefile.h"
#include "support/sourcefolder.h"
#include "support/tempfolder.h"

namespace kdx {
namespace {

using nlohmann::json;

const std::filesystem::path kCaseFile = test::sourceFolder() / "tests" / "settings" / "profile_cases.json";
const char* const kDefaultFile = "test.ini";  // for cases in which the name does not matter

struct ProfileCase {
    json content;
    [[nodiscard]] std::string name() const { return content.at("name"); }
    friend void PrintTo(const ProfileCase& recorded, std::ostream* out) { *out << recorded.name(); }
};

std::vector<ProfileCase> recordedCases() {
    std::ifstream file(kCaseFile);
    std::vector<ProfileCase> cases;
    for (const json& content : json::parse(file)) cases.push_back({content});
    return cases;
}

std::string fromHex(const std::string& digits) {
    std::string bytes;
    for (std::size_t i = 0; i < digits.size(); i += 2) {
        bytes += static_cast<char>(std::stoi(digits.substr(i, 2), nullptr, 16));
    }
    return bytes;
}

/// A name of a section or key: as bytes where it is not plain ASCII.
std::string nameIn(const json& operation, const std::string& field) {
    const std::string asBytes = field + "_hex";
    return operation.contains(asBytes) ? fromHex(operation.at(asBytes)) : operation.at(field).get<std::string>();
}

std::optional<std::string> bytesIn(const json& content, const char* field) {
    const json& digits = content.at(field);
    if (digits.is_null()) return std::nullopt;
    return fromHex(digits);
}

class ProfileCases : public ::testing::TestWithParam<ProfileCase> {
protected:
    void run(const json& operation) {
        const std::string file = operation.value("file", m_fileName);
        const std::string section = nameIn(operation, "section");
        const std::string key = nameIn(operation, "key");
        SCOPED_TRACE(operation.dump());
        if (operation.at("op") == "read") {
            EXPECT_EQ(m_data.ReadIni(section, key, file), fromHex(operation.at("expect_hex")));
        } else {
            m_data.WriteIni(section, key, fromHex(operation.at("value_hex")), file);
            EXPECT_EQ(!m_data.unsavedFile(), operation.at("ok").get<bool>());
        }
    }
    [[nodiscard]] std::vector<std::string> filesLeft() const {
        std::vector<std::string> names;
        for (const auto& entry : std::filesystem::directory_iterator(m_folder.data())) {
            if (entry.is_regular_file()) names.push_back(entry.path().filename().string());
        }
        std::sort(names.begin(), names.end());
        return names;
    }

    test::TempFolder m_folder;
    DataFolder m_data{m_folder.path()};
    std::string m_fileName = kDefaultFile;
};

TEST_P(ProfileCases, AreReadAndWrittenAsRecorded) {
    const json& content = GetParam().content;
    if (content.contains("extra_file") && !m_folder.tellsLetterCaseApart())
        GTEST_SKIP() << "names of files have no letter case here";
    m_fileName = content.value("file_name", m_fileName);
    if (content.contains("make_folder")) {
        std::filesystem::create_directory(m_folder.data() / content.at("make_folder").get<std::string>());
    }
    if (const auto before = bytesIn(content, "file_bytes_hex")) m_folder.write(m_fileName, *before);
    if (content.contains("extra_file")) {
        const json& extra = content.at("extra_file");
        m_folder.write(extra.at("name"), bytesIn(extra, "file_bytes_hex").value());
    }

    for (const json& operation : content.at("ops")) run(operation);

    std::vector<std::string> expectedFiles;
    const auto expectFile = [&](const std::string& name, const std::string& bytes) {
        expectedFiles.push_back(name);
        EXPECT_EQ(readFile(m_folder.data() / name), bytes);
    };
    if (const auto after = bytesIn(content, "final_bytes_hex")) {
        expectFile(content.contains("final_name") ? content.at("final_name").get<std::string>() : m_fileName, *after);
    }
    if (content.contains("extra_file")) {
        const json& extra = content.at("extra_file");
        expectFile(extra.at("name"), bytesIn(extra, "final_bytes_hex").value());
    }
    std::sort(expectedFiles.begin(), expectedFiles.end());
    EXPECT_EQ(filesLeft(), expectedFiles);
}

std::string caseName(const ::testing::TestParamInfo<ProfileCase>& info) {
    std::string name;
    bool wordStart = true;
    for (const char c : info.param.name()) {
        if (c != '_') name += wordStart ? upperCase({&c, 1}) : std::string(1, c);
        wordStart = c == '_';
    }
    return name;
}

INSTANTIATE_TEST_SUITE_P(Recorded, ProfileCases, ::testing::ValuesIn(recordedCases()), caseName);

TEST(ProfileCaseFileTest, HoldsEveryRecordedCase) {
    EXPECT_EQ(recordedCases().size(), 81U);
}

}  // namespace
}  // namespace kdx
