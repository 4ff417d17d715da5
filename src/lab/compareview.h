#pragma once

#include <QDialog>

#include "station/sidebyside.h"
#include "ui/caption.h"
#include "ui/pagecontext.h"

class QCheckBox;
class QLabel;
class QPushButton;
class QTableWidget;

namespace kdx {

struct Station;

/// The view that holds what the window has, what the data set's file has and what the instrument has against each
/// other, sends what differs and takes it over. Stays open beside the main window.
class CompareView : public QDialog {
    Q_OBJECT
public:
    /// @param station what was entered, kept true by the pages; outlives the view.
    CompareView(const Station& station, const PageContext& with, QWidget* parent);

    void label();
    /// What was read of an instrument holds as long as its session.
    void showSessionOpen(bool open);

signals:
    /// The files of the data set have other values now.
    void takenOver();

protected:
    void showEvent(QShowEvent* event) override;
    bool event(QEvent* event) override;

private:
    void Vergleich_Lesen_Click();
    void Vergleich_Senden_Click();
    void Vergleich_Uebernehmen_Click();
    void arrange();
    void read();
    void compare();
    void show(const QString& also);
    void showRow(int row, const SettingSideBySide& setting);
    [[nodiscard]] Station entered() const;
    [[nodiscard]] std::vector<SettingSideBySide> chosen() const;

    const Station& m_station;
    PageContext m_with;
    CaptionBook m_book;
    QTableWidget* Vergleich_Tabelle = nullptr;
    QLabel* Vergleich_Stand = nullptr;  // how much differs
    QCheckBox* Vergleich_Nur_Unterschiede = nullptr;
    QPushButton* Vergleich_Lesen = nullptr;
    QPushButton* Vergleich_Senden = nullptr;
    QPushButton* Vergleich_Uebernehmen = nullptr;
    QPushButton* Vergleich_Schliessen = nullptr;
    Readout m_present;  // empty until the instrument was read
    SideBySide m_compared;
};

}  // namespace kdx
