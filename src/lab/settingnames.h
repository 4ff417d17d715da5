#pragma once

#include <QString>

#include <string>

namespace kdx {

class Captions;

/// What a key that is read back stands for, as the window names it.
[[nodiscard]] QString settingName(const std::string& key, const Captions& captions);

}  // namespace kdx
