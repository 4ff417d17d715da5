#pragma once

#include <QString>

#include <string>

namespace kdx {

class Captions;

/// A warning of the transmission (UTF-8) in the current language; one that has no caption stays as it is.
[[nodiscard]] QString warningText(const Captions& captions, const std::string& warning);

}  // namespace kdx
