#pragma once

#include <QString>

#include "scenario/problems.h"
#include "ui/pagecontext.h"

namespace kdx {

struct WrongSetting;

/// What is wrong with a scenario's file at one place, in the language of the window.
[[nodiscard]] QString mistakeText(const PageContext& with, const scenario::Problem& problem);

/// What keeps a stored value from being sent, and where it is stored.
[[nodiscard]] QString mistakeText(const PageContext& with, const WrongSetting& wrong);

}  // namespace kdx
