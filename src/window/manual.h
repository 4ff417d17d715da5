#pragma once

#include <QObject>

#include <filesystem>

#include "ui/pagecontext.h"

class QTabWidget;
class QWidget;

namespace kdx {

class ManualView;

/// F1: opens the manual at what is in view, in the main window, a view or an editor.
class Manual : public QObject {
    Q_OBJECT
public:
    /// @param folder the manual's; @param pages the window's tabs.
    Manual(std::filesystem::path folder, const PageContext& with, QTabWidget& pages, QWidget* window);

    /// Opens it at what the control belongs to.
    void openAt(const QWidget& control);
    void label();

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    std::filesystem::path m_folder;
    PageContext m_with;
    QTabWidget& m_pages;
    QWidget* m_window;
    ManualView* m_view = nullptr;  // made when it is first opened
};

}  // namespace kdx
