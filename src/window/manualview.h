#pragma once

#include <QDialog>

#include <filesystem>

#include "ui/caption.h"
#include "ui/pagecontext.h"

class QLabel;
class QLineEdit;
class QPushButton;
class QTextBrowser;

namespace kdx {

/// A place in the manual: a chapter's file, and the picture whose section is meant; empty for its beginning.
struct ManualPlace {
    const char* chapter = "index.md";
    const char* picture = "";
};

/// The manual in the language of the window, with a search. Stays open beside the window that it was asked from.
class ManualView : public QDialog {
    Q_OBJECT
public:
    /// @param folder the manual's, with a folder of chapters for each of its languages.
    ManualView(std::filesystem::path folder, const PageContext& with, QWidget* parent);

    void openAt(const ManualPlace& place);
    /// Captions the view, and shows the same chapter in the language of now.
    void label();

private:
    void Handbuch_Suche_Return();
    void arrange();
    void showChapter(const QString& chapter);
    void showSectionOf(const QString& picture);
    [[nodiscard]] QString languageFolder() const;

    std::filesystem::path m_folder;
    PageContext m_with;
    CaptionBook m_book;
    QString m_language;  // whose chapters are shown
    QPushButton* Handbuch_Zurueck = nullptr;
    QPushButton* Handbuch_Vor = nullptr;
    QPushButton* Handbuch_Inhalt = nullptr;
    QLineEdit* Handbuch_Suche = nullptr;
    QPushButton* Handbuch_Weiter = nullptr;  // to the next place where the searched text stands
    QLabel* Handbuch_Stand = nullptr;
    QTextBrowser* Handbuch_Text = nullptr;
    QPushButton* Handbuch_Schliessen = nullptr;
};

}  // namespace kdx
