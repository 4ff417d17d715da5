#pragma once

#include <QLocale>
#include <QString>

#include <chrono>

#include "link/visa.h"

namespace kdx {

class Captions;

/// What a failure of the instrument means and what to do next, in the current language.
/// @param answerTime how long an answer may take.
[[nodiscard]] QString failureHint(VisaStatus status, std::chrono::milliseconds answerTime, const Captions& captions,
                                  const QLocale& locale);

}  // namespace kdx
