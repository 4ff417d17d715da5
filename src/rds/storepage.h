#pragma once

#include <QWidget>

#include <array>

#include "ui/pagecontext.h"

class QPushButton;

namespace kdx {

/// The page "Speichern": five buttons that save the coder's present state in one of its own memories.
class StorePage : public QWidget {
    Q_OBJECT
public:
    StorePage(const PageContext& with, QWidget* parent);
    void label();

private:
    void Store_Taste_Click(int index);

    std::array<QPushButton*, 5> Store_Taste{};
    PageContext m_with;
};

}  // namespace kdx
