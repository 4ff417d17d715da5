#pragma once

#include "support/pagetest.h"
#include "tmc/tmcpage.h"

#include <QListWidget>

#include <memory>
#include <string>

namespace kdx::test {

/// The TMC page as it is after a start, with a few events and locations.
class TmcPageTest : public PageTest {
protected:
    TmcPageTest() {
        folder.write("Event.txt",
                     "Verkehrsproblem;00001\r\nStau;00101\r\nTest;00026\r\nkein Code;abcde\r\nzu viel;04097\r\n");
        folder.write("Location.txt", "Musterstadt;12345\r\nBeispielheim;00007\r\nzu weit;65541\r\n");
        page->label();
        page->load();
    }
    QWidget& root() override { return *page; }

    /// Sets every field: the message of location 12345 and event 1, with group code 0810013039.
    void composeMessage() {
        select("TMC_Event_Combo", 0);
        select("TMC_Loc_Combo", 0);
        select("TMC_Var_Combo", 2);
        click("Tmc_richtung_0");
        for (const char* box : {"TMC_Div", "TMC_DP1_Check", "TMC_T_Check"}) {
            click(box);
            click(box);
        }
        click("TMC_F_Check");
    }
    /// Adds messages whose locations differ: number i ends in the group code with location i.
    void addMessages(int count) {
        composeMessage();
        for (int i = 0; i < count; ++i) {
            find<QLabel>("TMC_Gr8_Label")->setText(QString::fromStdString(code(i)));
            click("TMC_Gr8_apply");
        }
    }
    static std::string code(int message) {
        return "081001" + (message < 10 ? "000" + std::to_string(message) : "00" + std::to_string(message));
    }
    QListWidget& list() { return *find<QListWidget>("TMC_List"); }

    std::unique_ptr<TmcPage> page = std::make_unique<TmcPage>(context, nullptr);
};

}  // namespace kdx::test
