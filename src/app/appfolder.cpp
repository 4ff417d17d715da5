#include "app/appfolder.h"

#include "app/options.h"
#include "app/platform.h"
#include "settings/dataplace.h"

namespace kdx {

std::filesystem::path appFolder(const Options& options, const char* program, std::string& problem) {
    DataPlaces places;
    if (options.appFolder) places.asked = *options.appFolder;
    places.program = programFolder(program);
    places.user = userFolder();
    places.shipped = shippedFolder(places.program);
    return chooseAppFolder(places, problem);
}

std::filesystem::path shippedAppFolder(const char* program) {
    return shippedFolder(programFolder(program));
}

}  // namespace kdx
