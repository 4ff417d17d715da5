#pragma once

#include "af/aflistenform.h"

#include <gtest/gtest.h>

#include "support/listrows.h"
#include "support/pagetest.h"

#include <QKeyEvent>
#include <QListWidget>
#include <QMouseEvent>

#include <optional>

namespace kdx::test {

/// The editor of the AF lists, with three frequencies in list 1.
class EditorTest : public PageTest {
protected:
    EditorTest() {
        state.afEditorKind = "AF";
        setList("AF_LISTE1", "87.6,90.1,94.3");
    }
    QWidget& root() override { return *editor; }

    void setList(const char* key, const std::string& list) { setProfile(kSet1, "RDS", key, list); }
    void open() {
        editor.emplace(context, nullptr);
        editor->show();
    }
    void selectRow(int row) { find<QListWidget>("AF_List1")->setCurrentRow(row); }
    Lines rows() { return rowsOf(*find<QListWidget>("AF_List1")); }
    void clickTuned() {
        auto* label = find<QLabel>("AF_TN");
        QMouseEvent release(QEvent::MouseButtonRelease, QPointF(1, 1), label->mapToGlobal(QPointF(1, 1)),
                            Qt::LeftButton, Qt::NoButton, Qt::NoModifier);
        QApplication::sendEvent(label, &release);
    }
    void pressEnter(const char* name) {
        QKeyEvent press(QEvent::KeyPress, Qt::Key_Return, Qt::NoModifier);
        QApplication::sendEvent(find(name), &press);
    }
    void expectRefusal(std::size_t box, int caption) {
        ASSERT_GT(dialogs.shown.size(), box);
        EXPECT_EQ(dialogs.shown[box].icon, Dialogs::Icon::Exclamation);
        EXPECT_EQ(dialogs.shown[box].title, toText(captions.text(161)));
        EXPECT_EQ(dialogs.shown[box].text, toText(captions.text(caption)));
    }

    std::optional<AF_Listenform> editor;
};

}  // namespace kdx::test
