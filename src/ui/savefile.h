#pragma once

#include <QByteArray>
#include <QString>

#include <filesystem>
#include <functional>

#include "ui/caption.h"
#include "ui/pagecontext.h"

namespace kdx {

/// Asks for a file and lets what the user keeps for himself be saved there; tells him why where that cannot be.
/// @param name proposed for it, in his own folder. @param save writes the file; false when it fails.
void saveToChosenFile(const PageContext& with, const QString& title, const char* name, const Caption& kind,
                      const std::function<bool(const QString& file)>& save);

/// Why nothing of that kind may be written to the file, in words; "" when it may.
[[nodiscard]] QString whyNotSaved(const PageContext& with, const std::filesystem::path& file);

/// Writes the file whole or not at all.
[[nodiscard]] bool replaceWith(const QByteArray& content, const QString& file);

}  // namespace kdx
