#pragma once

#include <QString>

#include "scenario/scenario.h"
#include "ui/pagecontext.h"

namespace kdx {

/// What a step of a scenario does, in the language of the window: "senden PS=MESSTURM TP=1".
[[nodiscard]] QString stepText(const PageContext& with, const scenario::Action& action);

/// The same for the data set that is sent before the steps, and for what is brought back after them.
[[nodiscard]] QString openingText(const PageContext& with, int dataSet);
[[nodiscard]] QString restoringText(const PageContext& with);

}  // namespace kdx
