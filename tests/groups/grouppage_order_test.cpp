#include <QMouseEvent>

#include "grouppagetest.h"

namespace kdx::test {
namespace {

TEST_F(GroupPageTest, TheLastGroupCanBeRemoved) {
    press({0, 2, 8});
    EXPECT_EQ(state.group8ACount, 1);
    click("Gruppe_Zurueck");
    EXPECT_EQ(text("Label10"), "Gruppenfolge:0A,2A,");
    EXPECT_EQ(state.groupCount, 2);
    EXPECT_EQ(state.group8ACount, 0);
    click("Gruppe_Zurueck");
    click("Gruppe_Zurueck");
    EXPECT_EQ(text("Label10"), "Gruppenfolge:");
    EXPECT_FALSE(enabled("Gruppe_Zurueck"));
    press({1});
    click("GS_Senden");
    EXPECT_EQ(sent(), Lines{direct("GS=1A")});
}

TEST_F(GroupPageTest, TheMarkedGroupMoves) {
    press({0, 2, 10});
    EXPECT_FALSE(enabled("Gruppe_Nach"));
    click("Gruppe_Vor");
    EXPECT_EQ(text("Label10"), "Gruppenfolge:0A,10A,2A,");
    click("Gruppe_Vor");
    EXPECT_EQ(text("Label10"), "Gruppenfolge:10A,0A,2A,");
    EXPECT_FALSE(enabled("Gruppe_Vor"));
    click("Gruppe_Nach");
    EXPECT_EQ(text("Label10"), "Gruppenfolge:0A,10A,2A,");
    click("GS_Senden");
    EXPECT_EQ(sent(), Lines{direct("GS=0A,10A,2A")});
}

TEST_F(GroupPageTest, AClickOnAGroupMarksIt) {
    press({0, 2, 10});
    page.resize(600, 330);
    page.show();
    QApplication::processEvents();
    auto* label = find<QLabel>("Label10");
    const int x = label->fontMetrics().horizontalAdvance(QStringLiteral("Gruppenfolge:0A,2"));
    const QPointF at(x, label->margin() + label->fontMetrics().height() / 2.0);
    QMouseEvent event(QEvent::MouseButtonPress, at, label->mapToGlobal(at), Qt::LeftButton, Qt::LeftButton, {});
    QApplication::sendEvent(label, &event);
    click("Gruppe_Vor");
    EXPECT_EQ(text("Label10"), "Gruppenfolge:2A,0A,10A,");
}

TEST_F(GroupPageTest, TheShareOfEachGroupIsShown) {
    press({0, 0, 2, 8});
    EXPECT_EQ(text("Gruppe_Anteile"), "Anteile: 0A 50 %, 2A 25 %, 8A 25 %");
    click("newList");
    EXPECT_EQ(text("Gruppe_Anteile"), "");
}

TEST_F(GroupPageTest, AComposedSequenceIsMarkedUntilItIsSent) {
    const auto stateOf = [this] { return find("Label10")->property("zustand").toString().toStdString(); };
    EXPECT_EQ(stateOf(), "");
    press({0});
    EXPECT_EQ(stateOf(), "ungesendet");
    click("GS_Senden");
    EXPECT_EQ(stateOf(), "");
    press({2});
    EXPECT_EQ(stateOf(), "ungesendet");
    page.stepGoesOut(parameter("GROUPSEQ", "0A,2A"));  // with the whole data set
    EXPECT_EQ(stateOf(), "");
    for (int i = 0; i < 255; ++i) press({0});
    click("GS_Senden");
    EXPECT_EQ(stateOf(), "abgelehnt") << "more than the coder takes";
}

}  // namespace
}  // namespace kdx::test
