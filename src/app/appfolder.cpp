#include "app/appfolder.h"

#include "app/options.h"
#include "app/platform.h"
#include "base/paths.h"
#include "settings/dataplace.h"
#include "settings/shownpath.h"

namespace kdx {

std::filesystem::path appFolder(const Options& options, const char* program, bool heard, DataNews& news) {
    DataPlaces places;
    if (options.appFolder) places.asked = pathFromUtf8(*options.appFolder);
    places.program = programFolder(program);
    places.user = userFolder();
    places.shipped = shippedFolder(places.program);
    places.heard = heard;
    return chooseAppFolder(places, news);
}

std::string keptFileText(const std::filesystem::path& shipped) {
    return shownPath(shipped.filename()) + " stays as you changed it; a new version of it is " + shownPath(shipped);
}

std::filesystem::path shippedAppFolder(const char* program) {
    return shippedFolder(programFolder(program));
}

}  // namespace kdx
