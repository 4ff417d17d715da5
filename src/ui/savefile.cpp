#include "ui/savefile.h"

#include <QDir>
#include <QFileInfo>
#include <QSaveFile>

#include "base/paths.h"
#include "settings/datafolder.h"
#include "settings/ownfiles.h"
#include "settings/programstate.h"
#include "ui/dialogs.h"

namespace kdx {

void saveToChosenFile(const PageContext& with, const QString& title, const char* name, const Caption& kind,
                      const std::function<bool(const QString& file)>& save) {
    const auto caption = [&with](const Caption& one) { return captionText(with.captions, one); };
    const QString file =
        with.dialogs.fileToSave(title, QDir::home().filePath(QString::fromLatin1(name)), caption(kind));
    if (file.isEmpty()) return;
    const QString why = whyNotSaved(with, QFileInfo(file).filesystemAbsoluteFilePath());
    if (why.isEmpty() && save(file)) return;
    with.dialogs.message(Dialogs::Icon::Critical, caption({313, "Fehler"}),
                         caption({624, "%1 kann nicht gespeichert werden."}).arg(file), why);
}

QString whyNotSaved(const PageContext& with, const std::filesystem::path& file) {
    if (!with.data.mayWrite(file))
        return captionText(with.captions, {920, "Nur zum Lesen geöffnet: nichts wird gespeichert"});
    std::error_code error;
    const bool isOpened =
        !with.state.openedFile.empty() && std::filesystem::equivalent(pathFromUtf8(with.state.openedFile), file, error);
    if (!isOpened && !isOwnFile(with.data, file)) return {};
    return captionText(with.captions, {1120, "Diese Datei gehört dem Programm: bitte eine andere wählen."});
}

bool replaceWith(const QByteArray& content, const QString& file) {
    QSaveFile saved(file);
    return saved.open(QIODevice::WriteOnly) && saved.write(content) == content.size() && saved.commit();
}

}  // namespace kdx
