#include "window/datasetmenu.h"

#include <QAction>
#include <QMenu>

#include "ui/caption.h"
#include "window/datasets.h"

namespace kdx {

DataSetMenu::DataSetMenu(DataSets& sets, QWidget* window) : QObject(window), m_sets(sets) {
    Mnu_Datensatz = named<QMenu>("Mnu_Datensatz", window);
    Mnu_Datensatz_Sichern = named<QMenu>("Mnu_Datensatz_Sichern", window);
    m_savingHeading = Mnu_Datensatz_Sichern->addSection(QString());
    for (std::size_t i = 0; i < kSets; ++i) {
        const int set = static_cast<int>(i) + 1;
        m_choices[i] = element<QAction>("Mnu_Datensatz", i + 1, Mnu_Datensatz);
        m_choices[i]->setCheckable(true);
        m_targets[i] = element<QAction>("Mnu_Datensatz_Sichern", i + 1, Mnu_Datensatz_Sichern);
        connect(m_choices[i], &QAction::triggered, this, [this, set] {
            m_sets.choose(set);
            showSets();
        });
        connect(m_targets[i], &QAction::triggered, this, [this, set] {
            m_sets.saveAs(set);
            showSets();
        });
        Mnu_Datensatz->addAction(m_choices[i]);
        Mnu_Datensatz_Sichern->addAction(m_targets[i]);
    }
    Mnu_Datensatz->addSeparator();
    Mnu_Datensatz_Oeffnen = entry("Mnu_Datensatz_Oeffnen", Mnu_Datensatz, &DataSets::open);
    Mnu_Datensatz_Oeffnen->setShortcut(QKeySequence::Open);
    Mnu_Datensatz->addMenu(Mnu_Datensatz_Sichern);
    Mnu_Datensatz_Sichern_unter = entry("Mnu_Datensatz_Sichern_unter", Mnu_Datensatz, &DataSets::saveToFile);
    Mnu_Datensatz->addSeparator();
    Mnu_Datensatz_Umbenennen = entry("Mnu_Datensatz_Umbenennen", Mnu_Datensatz, &DataSets::rename);
    Mnu_Datensatz_Auslieferung = entry("Mnu_Datensatz_Auslieferung", Mnu_Datensatz, &DataSets::restore);
    for (QMenu* menu : {Mnu_Datensatz, Mnu_Datensatz_Sichern}) {
        connect(menu, &QMenu::aboutToShow, this, &DataSetMenu::showSets);  // other programs change the files too
    }
}

QAction* DataSetMenu::entry(const char* name, QMenu* menu, void (DataSets::*handler)()) {
    auto* action = named<QAction>(name, menu);
    connect(action, &QAction::triggered, &m_sets, handler);
    connect(action, &QAction::triggered, this, &DataSetMenu::showSets);
    menu->addAction(action);
    return action;
}

void DataSetMenu::label(const Captions& captions) {
    const auto text = [&captions](const Caption& caption) { return captionText(captions, caption); };
    Mnu_Datensatz->setTitle(text({891, "&Datensatz"}));
    Mnu_Datensatz_Oeffnen->setText(text({892, "&Öffnen..."}));
    Mnu_Datensatz_Sichern->setTitle(text({893, "&Sichern als Satz"}));
    m_savingHeading->setText(Mnu_Datensatz_Sichern->title().remove(QLatin1Char('&')));
    Mnu_Datensatz_Sichern_unter->setText(text({894, "Sichern u&nter..."}));
    Mnu_Datensatz_Umbenennen->setText(text({895, "&Umbenennen..."}));
    Mnu_Datensatz_Auslieferung->setText(text({896, "&Auslieferungszustand..."}));
    showSets();
}

void DataSetMenu::showSets() {
    for (std::size_t i = 0; i < kSets; ++i) {
        const int set = static_cast<int>(i) + 1;
        const QString about = m_sets.about(set).replace(QLatin1Char('&'), QLatin1String("&&"));
        for (QAction* action : {m_choices[i], m_targets[i]})
            action->setText(QStringLiteral("&%1  ").arg(set).append(about).trimmed());
        m_choices[i]->setChecked(set == m_sets.number());
    }
    Mnu_Datensatz_Auslieferung->setEnabled(m_sets.canBeRestored());
}

}  // namespace kdx
