#pragma once

#include <QDialog>

#include <array>

#include "ui/caption.h"
#include "ui/pagecontext.h"
#include "window/addressespage.h"

class QCheckBox;
class QComboBox;
class QDoubleSpinBox;
class QGroupBox;
class QPushButton;
class QSpinBox;
class QTabWidget;

namespace kdx {

class CorrectionsPage;
struct Place;

/// The general settings, each stored as soon as it is changed.
class SettingsDialog : public QDialog {
    Q_OBJECT
public:
    SettingsDialog(const PageContext& with, AddressesPage::Find find, QWidget* window);

    void label();
    /// Shows what is stored.
    void load();
    [[nodiscard]] AddressesPage& addresses() { return *m_addresses; }

signals:
    void languageChanged();
    void correctionsChanged();

private:
    QWidget* createProgramPage();
    QDoubleSpinBox* createLimit(const char* name, const Place& place, QWidget* parent);
    void Log_Schalter_Click();
    void Auto_Schalter_Click();
    void Sprache_Wahl_Click(int index);
    void RDS_RBDS_Wahl_Click(int index);

    PageContext m_with;
    CaptionBook m_book;
    QTabWidget* m_tabs = nullptr;
    QCheckBox* Log_Schalter = nullptr;
    QCheckBox* Auto_Schalter = nullptr;
    QComboBox* Sprache_Wahl = nullptr;
    QComboBox* RDS_RBDS_Wahl = nullptr;
    QSpinBox* PS_Dyn_Zahl = nullptr;
    std::array<QDoubleSpinBox*, 4> m_limits{};  // RF from and to, audio from and to
    CorrectionsPage* m_corrections = nullptr;
    AddressesPage* m_addresses = nullptr;
    QPushButton* m_close = nullptr;
};

}  // namespace kdx
