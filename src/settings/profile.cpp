#include "settings/profile.h"

#include "settings/datafolder.h"
#include "settings/profilefile.h"

namespace kdx {

std::string Profile::read(const Place& place) const {
    return m_data->ReadIni(place.section, place.key, fileOf(place));
}

bool Profile::holdsMore(const Place& place) const {
    const auto text = m_data->profile(fileOf(place));
    return text && text->value(place.section, place.key, kLongestValue + 1).size() > kLongestValue;
}

void Profile::write(const Place& place, std::string_view value) {
    m_data->WriteIni(place.section, place.key, value, fileOf(place));
}

std::string Profile::fileOf(const Place& place) const {
    switch (place.file) {
        case KeptIn::General:
            return kGeneralSettings;
        case KeptIn::DataSet:
            return m_dataSet != nullptr ? dataSetFile(*m_dataSet) : m_file;
        case KeptIn::DataSet1:
            break;
    }
    return dataSetFile("1");
}

}  // namespace kdx
