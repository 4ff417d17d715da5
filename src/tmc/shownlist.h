#pragma once

#include "ui/pagecontext.h"

#include <QFont>
#include <QStringList>

#include <functional>
#include <initializer_list>

namespace kdx {

/// The entries of an event or location file of the data folder, as the lists show them; an entry of
/// more than 1000 characters is cut there.
/// @throws std::runtime_error naming the file, in the current language, when it is missing or cannot be read.
[[nodiscard]] QStringList loadShownList(const PageContext& with, const char* fileName);

/// The fixed-pitch font of that name, or a twin with the same widths: the codes of the entries line up in it.
[[nodiscard]] QFont fixedPitch(const QString& family);

/// Takes every step even when an earlier one failed: one missing list must not cost the other.
/// @throws std::runtime_error with all that went wrong, a line each.
void takeAllSteps(std::initializer_list<std::function<void()>> steps);

}  // namespace kdx
