#include "settings/shippedfiles.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <map>
#include <optional>
#include <system_error>
#include <utility>

#include "base/codepage.h"
#include "base/paths.h"
#include "settings/datafolder.h"
#include "settings/folderlock.h"
#include "settings/profilefile.h"
#include "settings/shownpath.h"

namespace kdx {

namespace {

namespace fs = std::filesystem;

/// Which shipped versions the user has got or has been told of: "SIZE DIGEST NAME" a line.
constexpr const char* kKnownFile = "kdx-rds-shipped.txt";

std::string versionText(std::string_view bytes) {
    std::array<char, 16> digits{};
    const auto end = std::to_chars(digits.data(), digits.data() + digits.size(), digestOf(bytes), 16).ptr;
    return std::to_string(bytes.size()) + ' ' + std::string(digits.data(), end);
}

class KnownVersions {
public:
    explicit KnownVersions(fs::path file) : m_file(std::move(file)), m_text(readFile(m_file).value_or("")) {
        for (std::string_view rest = m_text; !rest.empty();) {
            const std::string_view line = rest.substr(0, rest.find('\n'));
            rest.remove_prefix(std::min(line.size() + 1, rest.size()));
            const std::size_t name = line.find(' ', line.find(' ') + 1);
            if (name != std::string_view::npos) m_versions[std::string(line.substr(name + 1))] = line.substr(0, name);
        }
    }
    [[nodiscard]] bool has(const std::string& name, std::string_view bytes) const {
        const auto found = m_versions.find(name);
        return found != m_versions.end() && found->second == versionText(bytes);
    }
    void note(const std::string& name, std::string_view bytes) { m_versions[name] = versionText(bytes); }
    /// Where it cannot be written, what is kept is told again.
    void save() const {
        std::string text;
        for (const auto& [name, version] : m_versions) text.append(version).append(" ").append(name).append("\n");
        if (text != m_text) (void)replaceFile(m_file, text);
    }

private:
    fs::path m_file;
    std::string m_text;
    std::map<std::string, std::string> m_versions;
};

bool isWrittenByTheProgram(const std::string& name) {
    if (equalNoCase(name, kGeneralSettings)) return true;
    return std::ranges::any_of(std::array{"1", "2", "3", "4", "5"},
                               [&](const char* number) { return equalNoCase(name, dataSetFile(number)); });
}

/// Whether the file is one of the versions. One that has another size than all of them is not read: it may be huge.
bool isOneOf(std::span<const ShippedVersion> versions, const std::string& name, const fs::path& file) {
    std::error_code error;
    const auto size = fs::file_size(file, error);
    const auto fits = [&](const ShippedVersion& version) { return version.size == size && version.name == name; };
    if (error || std::ranges::none_of(versions, fits)) return false;
    const auto bytes = readFile(file);
    if (!bytes) return false;
    const std::uint64_t digest = digestOf(*bytes);
    return std::ranges::any_of(versions,
                               [&](const auto& version) { return fits(version) && version.digest == digest; });
}

class Update {
public:
    Update(const DataFolder& user, std::span<const ShippedVersion> versions, bool heard, DataNews& news)
        : m_user(user), m_versions(versions), m_heard(heard), m_news(news), m_known(user.file(kKnownFile)) {}

    void take(const fs::path& shipped) {
        // A file whose name differs in letter case only is the same file.
        const fs::path mine = m_user.file(utf8Of(shipped.filename()));
        const std::string name = shownPath(shipped.filename());
        std::error_code ignored;
        const fs::file_status there = fs::status(mine, ignored);
        const bool isThere = fs::exists(there);
        if (isThere && (isWrittenByTheProgram(name) || !fs::is_regular_file(there))) return;
        const auto bytes = readFile(shipped);
        if (!bytes) {
            m_news.problem = shownPath(shipped);
        } else if (isThere && fileHolds(mine, *bytes)) {
            m_known.note(name, *bytes);
        } else if (!isThere || isOneOf(m_versions, name, mine)) {
            // Whole or not at all: half a file would count as changed by the user from the next start on.
            if (replaceFile(mine, *bytes)) {
                m_known.note(name, *bytes);
            } else {
                m_news.problem = shownPath(mine);
            }
        } else if (m_heard && !m_known.has(name, *bytes)) {
            m_news.kept.push_back(shipped);
            m_known.note(name, *bytes);
        }
    }
    void end() const { m_known.save(); }

private:
    const DataFolder& m_user;
    std::span<const ShippedVersion> m_versions;
    bool m_heard;
    DataNews& m_news;
    KnownVersions m_known;
};

}  // namespace

std::uint64_t digestOf(std::string_view bytes) {
    std::uint64_t digest = 0xcbf29ce484222325;
    for (const char byte : bytes) digest = (digest ^ static_cast<unsigned char>(byte)) * 0x100000001b3;
    return digest;
}

void bringUpToDate(const DataFolder& user, const fs::path& shipped, std::span<const ShippedVersion> versions,
                   bool heard, DataNews& news) {
    std::error_code error;
    fs::create_directories(user.path(), error);
    if (error) {
        news.problem = shownPath(user.path()) + ": " + error.message();
        return;
    }
    std::vector<fs::path> files;
    for (fs::directory_iterator entry(shipped, error), end; !error && entry != end; entry.increment(error)) {
        std::error_code ignored;
        if (entry->is_regular_file(ignored)) files.push_back(entry->path());
    }
    if (error) news.problem = shownPath(shipped) + ": " + error.message();
    std::ranges::sort(files);
    // Comparing and replacing are one step: a line that another program adds to a list meanwhile would be lost.
    const bool done = underFolderLock(user.path(), [&] {
        Update update(user, versions, heard, news);
        for (const fs::path& file : files) update.take(file);
        update.end();
    });
    if (!done) news.problem = shownPath(user.path());
}

}  // namespace kdx
