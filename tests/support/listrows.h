#pragma once

#include <QListWidget>

#include <cstddef>
#include <string>
#include <vector>

namespace kdx::test {

/// The texts of a list box, row by row, as UTF-8.
inline std::vector<std::string> rowsOf(const QListWidget& list) {
    std::vector<std::string> texts;
    texts.reserve(static_cast<std::size_t>(list.count()));
    for (int row = 0; row < list.count(); ++row) texts.push_back(list.item(row)->text().toStdString());
    return texts;
}

}  // namespace kdx::test
