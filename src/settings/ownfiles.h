#pragma once

#include <filesystem>

namespace kdx {

class DataFolder;

/// Keeps the messages of the traffic channel from start to start.
inline constexpr const char* kMessageFile = "TMC_Liste.txt";

/// Whether it is one of the files that the program itself keeps in the data folder, also by a link: what is saved there
/// for other ends would take the place of the running log, of settings or of a list.
[[nodiscard]] bool isOwnFile(const DataFolder& data, const std::filesystem::path& file);

}  // namespace kdx
