#pragma once

#include <filesystem>
#include <map>
#include <string>
#include <utility>

namespace kdx {

/// The texts of the event and location lists by their codes, as a traffic message names them.
class TrafficLists {
public:
    /// @param folder where the lists are; they are read when a text is first asked for.
    explicit TrafficLists(std::filesystem::path folder) : m_folder(std::move(folder)) {}

    /// The text (Windows-1252); "" for a code that the list does not have.
    [[nodiscard]] const std::string& event(unsigned code);
    [[nodiscard]] const std::string& location(unsigned code);
    /// The lists were changed.
    void forget();

private:
    using Texts = std::map<unsigned, std::string>;
    [[nodiscard]] const std::string& textOf(Texts& known, const char* file, unsigned code) const;

    std::filesystem::path m_folder;
    Texts m_events;  ///< those that were asked for
    Texts m_locations;
};

}  // namespace kdx
