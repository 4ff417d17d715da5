#pragma once

#include <filesystem>
#include <map>
#include <string>

#include "settings/profile.h"

namespace kdx {

class ProfileText;
struct Station;

/// The settings of a data set alone, what its section "RDS" holds: by their keys in upper case, as they are written.
using DataSetContent = std::map<std::string, std::string>;

/// Where a data set keeps the name that its user gave it; never sent.
inline constexpr Place kDataSetName{KeptIn::DataSet, "Datensatz", "Name"};

/// The data set that is stored in the file.
[[nodiscard]] DataSetContent storedDataSet(const ProfileText& file);

/// What the file of the set at work holds, renewed by what the window holds: also what was typed and not sent yet.
/// @param blanksCount texts keep the blanks at their edges.
[[nodiscard]] DataSetContent dataSetAtWork(const ProfileText& file, const Station& station, bool blanksCount);

/// Puts a data set into a file that may hold another one, of which nothing stays; other sections stay as they are.
void putDataSet(const DataSetContent& content, ProfileText& file);

/// The same on disk; a missing file is made. @returns false when the file cannot be read or written, and then it is as
/// it was.
[[nodiscard]] bool writeDataSet(const DataSetContent& content, const std::filesystem::path& file);

}  // namespace kdx
