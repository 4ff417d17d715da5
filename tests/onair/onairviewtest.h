#pragma once

#include <QTableWidget>

#include "onair/onairview.h"
#include "support/windowtest.h"

namespace kdx::test {

/// The window on the shipped data, with a sequence that has a slot for everything, and the view open beside it.
class OnAirViewTest : public WindowTest {
protected:
    void open(const char* language = "deutsch") {
        folder.copyShipped();
        setGeneral("Sprache", "Sprache", language);
        start();
        openSession();
        session->params.SendParam("GROUPSEQ", "0A,2A,3A,8A,14A");
        openView();
    }
    void openView() {
        action("Mnu_Ansicht_OnAir")->trigger();
        view = window->findChild<OnAirView*>();
        ASSERT_NE(view, nullptr);
    }
    /// Lets so much go out.
    void listen(std::chrono::seconds time = std::chrono::seconds{10}) {
        clock.advance(time);
        ASSERT_TRUE(tick("AirTimer"));
    }
    /// Composes a traffic message and sends it once.
    void sendMessage() {
        select("TMC_Event_Combo", 0);
        select("TMC_Loc_Combo", 0);
        select("TMC_Var_Combo", 2);
        click("Tmc_richtung_0");
        for (const char* box : {"TMC_Div", "TMC_DP1_Check", "TMC_T_Check"}) {
            click(box);
            click(box);
        }
        click("TMC_F_Check");
        click("TMC_Gr8_apply");
        click("TMC_Senden_Taste");
        ASSERT_TRUE(tick("TMC_Sende_Timer"));
    }
    QTableWidget* table(const char* name) { return find<QTableWidget>(name); }
    std::string cell(const char* name, int row, int column) {
        const QTableWidgetItem* item = table(name)->item(row, column);
        return item == nullptr ? std::string("no such cell") : item->text().toStdString();
    }
    /// The tool tip of a row's sign; "" when it is not marked.
    std::string mark(const char* name) {
        const auto* sign = find<QLabel>((std::string(name) + "_Zeichen").c_str());
        EXPECT_EQ(sign->text().isEmpty(), sign->toolTip().isEmpty());
        return sign->toolTip().toStdString();
    }
    /// The tool tip of another network's row in the table; "no such network" when it is not there.
    std::string remark(const std::string& pi) {
        for (int row = 0; row < table("Air_EON")->rowCount(); ++row) {
            const QTableWidgetItem* item = table("Air_EON")->item(row, 0);
            if (item->text().endsWith(QString::fromStdString(pi))) return item->toolTip().toStdString();
        }
        return "no such network";
    }
    /// All cells of a table, a row a line.
    std::string cells(const char* name) {
        std::string all;
        for (int row = 0; row < table(name)->rowCount(); ++row) {
            for (int column = 0; column < table(name)->columnCount(); ++column) all += cell(name, row, column) + "|";
            all += "\n";
        }
        return all;
    }

    OnAirView* view = nullptr;
};

}  // namespace kdx::test
