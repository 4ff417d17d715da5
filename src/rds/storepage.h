#pragma once

#include <QPushButton>

#include <array>

#include "ui/page.h"

namespace kdx {

/// The page "Speichern": five buttons that save the coder's present state in one of its own memories.
class StorePage : public Page {
    Q_OBJECT
public:
    StorePage(const PageContext& with, QWidget* parent);

private:
    void Store_Taste_Click(int index);

    std::array<QPushButton*, 5> Store_Taste{};
};

}  // namespace kdx
