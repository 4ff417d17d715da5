#pragma once

#include <QObject>

#include <array>

class QAction;
class QMenu;

namespace kdx {

class Captions;
class DataSets;

/// The menu of the data sets; each entry says which one it is.
class DataSetMenu : public QObject {
    Q_OBJECT
public:
    DataSetMenu(DataSets& sets, QWidget* window);

    void label(const Captions& captions);
    [[nodiscard]] QMenu* menu() const { return Mnu_Datensatz; }
    [[nodiscard]] QMenu* savingMenu() const { return Mnu_Datensatz_Sichern; }

private:
    static constexpr std::size_t kSets = 5;

    void showSets();
    QAction* entry(const char* name, QMenu* menu, void (DataSets::*handler)());

    DataSets& m_sets;
    QMenu* Mnu_Datensatz = nullptr;
    std::array<QAction*, kSets> m_choices{};  // Mnu_Datensatz_1 to _5
    QAction* Mnu_Datensatz_Oeffnen = nullptr;
    QMenu* Mnu_Datensatz_Sichern = nullptr;
    QAction* m_savingHeading = nullptr;       // says what it is where it pops up by its key
    std::array<QAction*, kSets> m_targets{};  // Mnu_Datensatz_Sichern_1 to _5
    QAction* Mnu_Datensatz_Sichern_unter = nullptr;
    QAction* Mnu_Datensatz_Umbenennen = nullptr;
    QAction* Mnu_Datensatz_Auslieferung = nullptr;
};

}  // namespace kdx
