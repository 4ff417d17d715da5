#pragma once

#include <string>
#include <string_view>
#include <utility>

namespace kdx {

class DataFolder;

/// Which of the data folder's files a setting is kept in.
enum class KeptIn {
    General,   ///< the general settings
    DataSet,   ///< the file of the data set at work
    DataSet1,  ///< the file of data set 1, whatever set is at work
};

/// Where a setting is kept.
struct Place {
    KeptIn file;
    const char* section;
    const char* key;
};

/// How a setting is sent and where it is kept.
struct Setting {
    const char* sendKey;  ///< key for the dispatcher; "" for what is never sent by itself
    Place place;
};

/// Reads and writes settings by their places. Texts are 8-bit Windows-1252; everything else is as DataFolder has it.
class Profile {
public:
    /// @param number of the data set at work, "1" to "5"; lent and outliving the profile, its changes are followed.
    /// @param opened a file that takes the place of the data set's while it is not empty; lent and followed likewise.
    [[nodiscard]] static Profile followingDataSet(DataFolder& data, const std::string& number,
                                                  const std::string* opened = nullptr) {
        return {data, &number, opened, {}};
    }
    /// The same with any file in the place of a data set's. One that has a section "FM" holds a whole set-up: the
    /// multiplex, which data sets leave to the general settings, and the carrier come from there too, as far as it has
    /// them.
    /// @param file absolute, or relative to the data folder; in UTF-8.
    [[nodiscard]] static Profile ofFile(DataFolder& data, const std::string& file);

    /// "" when nothing is there.
    [[nodiscard]] std::string read(const Place& place) const;
    /// Whether more is stored there than read() gives.
    [[nodiscard]] bool holdsMore(const Place& place) const;
    void write(const Place& place, std::string_view value);
    /// The name of the file that the place is in, as DataFolder takes it.
    [[nodiscard]] std::string fileOf(const Place& place) const;
    /// Whether that file has any setting in the place's section.
    [[nodiscard]] bool hasSectionOf(const Place& place) const;

private:
    Profile(DataFolder& data, const std::string* number, const std::string* opened, std::string file)
        : m_data(&data), m_dataSet(number), m_opened(opened), m_file(std::move(file)) {}
    [[nodiscard]] bool hasInSetup(const Place& place) const;

    DataFolder* m_data;
    const std::string* m_dataSet;
    const std::string* m_opened;
    std::string m_file;
    bool m_wholeSetup = false;
};

}  // namespace kdx
