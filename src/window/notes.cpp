#include "window/notes.h"

#include <filesystem>

#include "settings/captions.h"
#include "settings/datafolder.h"
#include "settings/folderlock.h"
#include "settings/programstate.h"
#include "settings/shownpath.h"
#include "station/session.h"
#include "ui/caption.h"
#include "ui/pictureswitch.h"
#include "ui/text.h"
#include "window/surroundings.h"

namespace kdx {

namespace {

/// What keeps the captions away is told in both languages: no other text can be looked up.
QString missingLanguage(const Surroundings& with) {
    const std::filesystem::path file = with.data.file(kLanguageFile);
    const QString shown = QString::fromStdString(shownPath(file));
    std::error_code error;
    if (!std::filesystem::exists(file, error)) return QStringLiteral("Nicht gefunden / not found: ") + shown;
    return with.data.profile(kLanguageFile) ? QString() : QStringLiteral("Nicht lesbar / cannot be read: ") + shown;
}

}  // namespace

QStringList notes(const Surroundings& with, const QWidget& window, const QString& startNotice) {
    QStringList notes;
    const auto note = [&](const Caption& caption, const QString& what = {}) {
        const QString text = captionText(with.captions, caption);
        notes += what.isEmpty() ? text : text.arg(what);
    };
    if (!with.dataProblem.isEmpty()) notes += with.dataProblem;
    if (const QString missing = missingLanguage(with); with.captions.isEmpty() && !missing.isEmpty()) {
        notes += missing;
    } else if (with.captions.isEmpty()) {
        // Garbage, or without this language.
        note({322, "Nicht gefunden: %1"},
             QStringLiteral("%1 [%2]").arg(QLatin1String(kLanguageFile), toText(with.state.language)));
    } else if (!startNotice.isEmpty()) {
        notes += startNotice;
    }
    QStringList kept;
    for (const auto& shipped : with.keptFiles) kept += QString::fromStdString(shownPath(shipped));
    if (!kept.isEmpty()) {
        note({1100, "Von Ihnen geändert, darum nicht erneuert; neue Fassung: %1"}, kept.join(QStringLiteral(", ")));
    }
    QStringList unreadable;
    if (const auto file = with.data.unreadableFile()) unreadable += toText(*file);
    for (const PictureSwitch* button : window.findChildren<PictureSwitch*>()) unreadable += button->brokenPicture();
    unreadable.removeAll(QString());
    unreadable.removeDuplicates();
    if (!unreadable.isEmpty()) note({325, "Nicht lesbar: %1"}, unreadable.join(QStringLiteral(", ")));
    if (const auto unsaved = with.data.unsavedFile(); unsaved && !with.data.isReadOnly()) {
        note({312, "Nicht gespeichert: %1"}, toText(*unsaved));
    }
    if (!with.session.instrument.log.isWritable()) note({312, "Nicht gespeichert: %1"}, toText(kCommandLog));
    if (with.data.isReadOnly()) note({920, "Nur zum Lesen geöffnet: nichts wird gespeichert"});
    if (with.claim.isShared()) note({326, "Ein anderes Programm nutzt dieselben Daten"});
    QStringList quoted;
    for (const std::string& key : with.session.params.quotedKeys()) quoted += toText(key);
    if (!quoted.isEmpty()) note({327, "Anführungszeichen beendet den Text: %1"}, quoted.join(QStringLiteral(", ")));
    return notes;
}

}  // namespace kdx
