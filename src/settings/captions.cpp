#include "settings/captions.h"

#include "base/codepage.h"
#include "base/numbers.h"
#include "settings/datafolder.h"
#include "settings/profilefile.h"

#include <charconv>
#include <stdexcept>

namespace kdx {

namespace {

/// Captions have numbers without leading zeros: "01" is none.
bool isNumber(std::string_view key) {
    int number = 0;
    const auto read = std::from_chars(key.data(), key.data() + key.size(), number);
    return read.ec == std::errc() && key == std::to_string(number);
}

}  // namespace

Captions::Captions(const DataFolder& data) : m_data(data) {}

void Captions::load(const std::string& language, const std::string& standard) {
    m_file = m_data.profile(kLanguageFile);
    m_language = language;
    m_typeList = language == "deutsch" ? "PTY-Liste_D" : standard == "RBDS" ? "PTY-Liste_US" : "PTY-Liste_E";
}

bool Captions::isEmpty() const {
    return !m_file || !m_file->anyKey(m_language, isNumber);
}

std::string Captions::text(int number) const {
    return m_file ? m_file->value(m_language, std::to_string(number)) : std::string();
}

std::string Captions::programmeType(std::size_t type) const {
    if (type >= kProgrammeTypes) throw std::out_of_range("no programme type has that number");
    return m_file ? m_file->value(m_typeList, rightmost("000" + std::to_string(type), 3)) : std::string();
}

std::string Captions::own(int number, std::string_view design) const {
    std::string found = text(number);
    return found.empty() ? fromUtf8(design) : found;
}

}  // namespace kdx
