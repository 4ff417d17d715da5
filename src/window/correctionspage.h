#pragma once

#include <QCheckBox>

#include <array>

#include "settings/corrections.h"
#include "ui/pagecontext.h"

class QLabel;

namespace kdx {

/// The page of the settings that corrects described ways of the program, one by one or all at once; each with a
/// sentence about what happens without and with it.
class CorrectionsPage : public QWidget {
    Q_OBJECT
public:
    CorrectionsPage(const PageContext& with, QWidget* parent);

    void label();
    /// Shows what the general settings hold.
    void load();

signals:
    void changed();

private:
    void Berichtigung_Click(std::size_t index);
    void Alle_Berichtigungen_Click();
    void store(std::size_t index, bool on);
    void showWhetherAll();

    PageContext m_with;
    std::array<QCheckBox*, kCorrectionKeys.size()> Berichtigung{};
    std::array<QLabel*, kCorrectionKeys.size()> m_sentences{};
    QCheckBox* Alle_Berichtigungen = nullptr;
};

}  // namespace kdx
