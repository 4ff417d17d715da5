#include "window/manual.h"

#include <QCoreApplication>
#include <QKeyEvent>
#include <QMessageBox>
#include <QTabWidget>

#include <array>
#include <utility>

#include "window/manualview.h"
#include "window/pages.h"

namespace kdx {

namespace {

struct Section {
    const char* window;
    ManualPlace place;
};

constexpr std::array kSections = {Section{"OnAirView", {"on-air.md"}},
                                  Section{"CompareView", {"compare.md"}},
                                  Section{"ScenarioView", {"scenarios.md"}},
                                  Section{"LogView", {"log.md"}},
                                  Section{"SettingsDialog", {"settings.md"}},
                                  Section{"AF_Listenform", {"page-af-list.md", "af-editor.png"}},
                                  Section{"TMC_Listedit", {"page-tmc.md", "tmc-list-editor.png"}},
                                  Section{"ManualView", {}}};

/// The section about the innermost window of ours that the control stands in.
ManualPlace sectionOf(const QWidget& control, int page) {
    for (const QWidget* around = &control; around != nullptr; around = around->parentWidget()) {
        if (qobject_cast<const QMessageBox*>(around) != nullptr) return {"trouble.md"};
        for (const Section& section : kSections) {
            if (around->objectName() == QLatin1String(section.window)) return section.place;
        }
    }
    return page < 0 ? ManualPlace{} : ManualPlace{pageRows()[static_cast<std::size_t>(page)].chapter};
}

}  // namespace

Manual::Manual(std::filesystem::path folder, const PageContext& with, QTabWidget& pages, QWidget* window)
    : m_folder(std::move(folder)), m_with(with), m_pages(pages), m_window(window) {
    // Views and editors are windows of their own, which a key of the main window does not reach.
    QCoreApplication::instance()->installEventFilter(this);
}

bool Manual::eventFilter(QObject* watched, QEvent* event) {
    if (event->type() != QEvent::KeyPress) return false;
    const auto* key = static_cast<QKeyEvent*>(event);
    const auto* control = qobject_cast<QWidget*>(watched);
    if (control == nullptr || key->key() != Qt::Key_F1 || key->modifiers() != Qt::NoModifier) return false;
    openAt(*control);
    return true;
}

void Manual::openAt(const QWidget& control) {
    const ManualPlace place = sectionOf(control, m_pages.currentIndex());
    QWidget* asking = control.window();
    if (asking->isModal()) {  // which lets nothing be used but its own windows
        auto* view = asking->findChild<ManualView*>(QString(), Qt::FindDirectChildrenOnly);
        if (view == nullptr) view = new ManualView(m_folder, m_with, asking);
        view->openAt(place);
        return;
    }
    if (auto* view = qobject_cast<ManualView*>(asking)) {  // also one that belongs to an editor
        view->openAt(place);
        return;
    }
    if (m_view == nullptr) m_view = new ManualView(m_folder, m_with, m_window);
    m_view->openAt(place);
}

void Manual::label() {
    if (m_view != nullptr) m_view->label();
}

}  // namespace kdx
