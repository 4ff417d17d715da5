#pragma once

#include <QListView>
#include <QMouseEvent>

#include <memory>

#include "support/pagetest.h"
#include "tmc/tmclistedit.h"

namespace kdx::test {

class TmcListeditTest : public PageTest {
protected:
    TmcListeditTest() {
        folder.write("Event.txt", "Stau;00101\r\nUnfall;00201\r\n");
        folder.write("Location.txt", "Musterstadt;12345\r\n");
        open();
    }
    void open() {
        editor = std::make_unique<TMC_Listedit>(context, nullptr);
        editor->show();
    }
    QWidget& root() override { return *editor; }

    Lines entries(const char* name) {
        Lines lines;
        const QAbstractItemModel& shown = *find<QListView>(name)->model();
        for (int row = 0; row < shown.rowCount(); ++row)
            lines.push_back(shown.index(row, 0).data().toString().toStdString());
        return lines;
    }
    /// Clicks an input label and answers the box that it opens.
    void enter(const char* name, const char* answer) {
        dialogs.inputs.push_back(QString::fromUtf8(answer));
        auto* label = find(name);
        const QPointF at(2, 2);
        QMouseEvent release(QEvent::MouseButtonRelease, at, label->mapToGlobal(at), Qt::LeftButton, Qt::NoButton,
                            Qt::NoModifier);
        QApplication::sendEvent(label, &release);
    }
    static std::string entry(const std::string& text, const std::string& code) {
        return text + std::string(42 - text.size(), ' ') + code;
    }

    std::unique_ptr<TMC_Listedit> editor;
};

}  // namespace kdx::test
