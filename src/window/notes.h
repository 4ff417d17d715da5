#pragma once

#include <QStringList>

class QWidget;

namespace kdx {

struct Surroundings;

/// What the user should know at present, in the current language: data that are missing, cannot be read or saved, are
/// used by another program, or end a text early.
/// @param window whose pictures are asked; @param startNotice what start-up could not read.
[[nodiscard]] QStringList notes(const Surroundings& with, const QWidget& window, const QString& startNotice);

}  // namespace kdx
