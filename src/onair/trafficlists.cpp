#include "onair/trafficlists.h"

#include <optional>

#include "base/numbers.h"
#include "settings/datafolder.h"
#include "tmc/tmclist.h"

namespace kdx {

namespace {

std::string lookUp(const std::filesystem::path& file, unsigned code) {
    const std::optional<TmcList> list = loadTmcList(file);
    for (std::size_t i = 0; list && i < list->size(); ++i) {
        const std::string entry = (*list)[i];
        if (leadingNumber(std::string_view(entry).substr(kListTextLength)) != code) continue;
        const std::string text = entry.substr(0, kListTextLength);
        return text.substr(0, text.find_last_not_of(' ') + 1);
    }
    return {};
}

}  // namespace

const std::string& TrafficLists::event(unsigned code) {
    return textOf(m_events, kEventList, code);
}

const std::string& TrafficLists::location(unsigned code) {
    return textOf(m_locations, kLocationList, code);
}

void TrafficLists::forget() {
    m_events.clear();
    m_locations.clear();
}

const std::string& TrafficLists::textOf(Texts& known, const char* file, unsigned code) const {
    const auto [text, isNew] = known.try_emplace(code);
    if (isNew) text->second = lookUp(m_folder / file, code);
    return text->second;
}

}  // namespace kdx
