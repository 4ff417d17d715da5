#include "settings/ownfiles.h"

#include <algorithm>
#include <string>
#include <system_error>
#include <vector>

#include "base/codepage.h"
#include "base/paths.h"
#include "settings/datafolder.h"

namespace kdx {

bool isOwnFile(const DataFolder& data, const std::filesystem::path& file) {
    namespace fs = std::filesystem;
    std::vector<std::string> names{kGeneralSettings, kLanguageFile, kCommandLog, kEventList,
                                   kLocationList,    kMessageFile,  kPictureOn,  kPictureOff};
    for (const char* number : {"1", "2", "3", "4", "5"}) names.push_back(dataSetFile(number));
    std::error_code error;
    const fs::path folder = fs::weakly_canonical(data.path(), error);
    const fs::path target = fs::weakly_canonical(file, error);
    return std::any_of(names.begin(), names.end(), [&](const std::string& name) {
        const bool isNamedSo = target.parent_path() == folder && equalNoCase(utf8Of(target.filename()), name);
        return isNamedSo || fs::equivalent(data.file(name), file, error);
    });
}

}  // namespace kdx
