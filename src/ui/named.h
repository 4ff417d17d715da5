#pragma once

#include <QString>

#include <cstddef>
#include <utility>

namespace kdx {

/// Makes a control that bears the system's name, by which it is found.
template <typename Control, typename... Args>
Control* named(const char* name, Args&&... args) {
    auto* control = new Control(std::forward<Args>(args)...);
    control->setObjectName(QString::fromLatin1(name));
    return control;
}

/// Element `index` of a control array: its name is the array's name, an underscore and the index.
template <typename Control, typename... Args>
Control* element(const char* array, std::size_t index, Args&&... args) {
    auto* control = new Control(std::forward<Args>(args)...);
    control->setObjectName(QStringLiteral("%1_%2").arg(QString::fromLatin1(array)).arg(index));
    return control;
}

}  // namespace kdx
