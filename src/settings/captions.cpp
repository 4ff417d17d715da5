#include "settings/captions.h"

#include "base/codepage.h"
#include "base/numbers.h"
#include "settings/datafolder.h"
#include "settings/profilefile.h"

#include <charconv>

namespace kdx {

Captions::Captions(const DataFolder& data) : m_data(data) {}

void Captions::load(const std::string& language, const std::string& standard) {
    m_texts.clear();
    m_programmeTypes.fill({});
    // One look at the file instead of one per caption: a relabelling asks for some three hundred.
    const ProfileText file(readFile(m_data.file(kLanguageFile)).value_or(std::string()));
    for (const auto& [key, value] : file.section(language)) {
        int number = 0;
        const auto read = std::from_chars(key.data(), key.data() + key.size(), number);
        // Numbers stand without leading zeros: "01" is no caption.
        if (read.ec == std::errc() && key == std::to_string(number)) m_texts.emplace(number, value);
    }
    const char* list = "PTY-Liste_D";
    if (language != "deutsch") list = standard == "RBDS" ? "PTY-Liste_US" : "PTY-Liste_E";
    const auto names = file.section(list);
    for (std::size_t type = 0; type < m_programmeTypes.size(); ++type) {
        const auto name = names.find(rightmost("000" + std::to_string(type), 3));
        if (name != names.end()) m_programmeTypes[type] = name->second;
    }
}

std::string Captions::text(int number) const {
    const auto found = m_texts.find(number);
    return found == m_texts.end() ? std::string() : found->second;
}

std::string Captions::own(int number, std::string_view design) const {
    const auto found = m_texts.find(number);
    return found == m_texts.end() || found->second.empty() ? fromUtf8(design) : found->second;
}

}  // namespace kdx
