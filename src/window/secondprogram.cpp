#include "window/secondprogram.h"

#include "settings/captions.h"
#include "settings/datafolder.h"
#include "settings/folderlock.h"
#include "settings/generalsettings.h"
#include "settings/shownpath.h"
#include "ui/caption.h"
#include "ui/dialogs.h"
#include "ui/text.h"

namespace kdx {

bool goesOnBesideAnother(const FolderClaim& claim, DataFolder& data, Captions& captions, Dialogs& dialogs) {
    if (!claim.isShared()) return true;
    const auto stored = [&data](const Place& place) {
        return data.ReadIni(place.section, place.key, kGeneralSettings);
    };
    captions.load(languageOrDesign(stored(setting::kLanguage)), stored(setting::kStandard));
    const Caption question{919, "Ein anderes Programm nutzt %1. Nur zum Lesen öffnen? \"Nein\" beendet dieses."};
    const QString folder = QString::fromStdString(shownPath(data.path()));
    if (!dialogs.confirm(QStringLiteral("KDX-RDS"), captionText(captions, question).arg(folder))) return false;
    data.setReadOnly();
    return true;
}

}  // namespace kdx
