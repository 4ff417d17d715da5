#include <fstream>
#include <system_error>

#include "settings/durablefile.h"

namespace kdx {

bool userMayWrite(const std::filesystem::path& file) {
    return std::ofstream(file, std::ios::binary | std::ios::app).is_open();  // opened for appending: nothing changes
}

bool writeNewFile(const std::filesystem::path& file, std::string_view bytes, const std::filesystem::path& model) {
    std::error_code error;
    if (std::filesystem::exists(file, error) || error) return false;
    std::ofstream stream(file, std::ios::binary);
    stream.write(bytes.data(), static_cast<std::streamsize>(bytes.size()));
    stream.close();
    if (!stream) return false;
    const std::filesystem::file_status modelStatus = std::filesystem::status(model, error);
    if (!std::filesystem::exists(modelStatus)) return true;
    std::filesystem::permissions(file, modelStatus.permissions(), error);
    return !error;
}

void flushFolder(const std::filesystem::path&) {}  // the standard library has no means for it

}  // namespace kdx
