#include "settings/profile.h"

#include "base/codepage.h"
#include "settings/datafolder.h"
#include "settings/profilefile.h"

namespace kdx {

namespace {

constexpr std::string_view kMultiplexSection = "FM";
constexpr std::string_view kCarrierSection = "VRN";

}  // namespace

Profile Profile::ofFile(DataFolder& data, const std::string& file) {
    Profile profile(data, nullptr, nullptr, file);
    const auto text = data.profile(profile.m_file);
    profile.m_wholeSetup = text != nullptr && text->anyKey(kMultiplexSection, [](std::string_view) { return true; });
    return profile;
}

std::string Profile::read(const Place& place) const {
    return m_data->ReadIni(place.section, place.key, fileOf(place));
}

bool Profile::holdsMore(const Place& place) const {
    const auto text = m_data->profile(fileOf(place));
    return text && text->value(place.section, place.key, kLongestValue + 1).size() > kLongestValue;
}

bool Profile::hasInSetup(const Place& place) const {
    const std::string_view section = place.section;
    if (section != kMultiplexSection && section != kCarrierSection) return false;
    const auto text = m_data->profile(m_file);
    return text && text->anyKey(section, [&](std::string_view key) { return equalNoCase(key, place.key); });
}

void Profile::write(const Place& place, std::string_view value) {
    m_data->WriteIni(place.section, place.key, value, fileOf(place));
}

bool Profile::hasSectionOf(const Place& place) const {
    const auto text = m_data->profile(fileOf(place));
    return text && text->anyKey(place.section, [](std::string_view) { return true; });
}

std::string Profile::fileOf(const Place& place) const {
    if (m_wholeSetup && hasInSetup(place)) return m_file;
    switch (place.file) {
        case KeptIn::General:
            return kGeneralSettings;
        case KeptIn::DataSet:
            if (m_opened != nullptr && !m_opened->empty()) return *m_opened;
            return m_dataSet != nullptr ? dataSetFile(*m_dataSet) : m_file;
        case KeptIn::DataSet1:
            break;
    }
    return dataSetFile("1");
}

}  // namespace kdx
