#pragma once

#include "af/eonpage.h"

#include <gmock/gmock.h>

#include "af/othernetwork.h"
#include "support/listrows.h"
#include "support/pagetest.h"

#include <memory>

namespace kdx::test {

/// The page "E O N" with a network D3C2, "RADIO 1", in data set 1.
class EonPageTest : public PageTest {
protected:
    EonPageTest() {
        makePage(context);
        store("EON_PI", "D3C2");
        store("EON_PS", "RADIO 1");
        store("EON_TP", "1");
    }

    QWidget& root() override { return *page; }

    void makePage(const PageContext& with) {
        page = std::make_unique<EonPage>(with, network, nullptr);
        page->openEditorBy([] { FAIL() << "nobody pressed the button that opens the editor"; });
        page->label();
    }
    void store(const std::string& key, const std::string& value) { setProfile(kSet, "RDS", key, value); }
    std::string stored(const std::string& key) { return profile(kSet, "RDS", key); }
    /// Start-up: the network of the data set first, then the page.
    void startUp() {
        network.load(settings);
        page->load();
    }
    /// The same; the own programme then allows an announcement of the other one.
    void load() {
        startUp();
        indicate("aus", "ein");
    }
    void indicate(std::string_view tp, std::string_view ta) {
        statusRow.show(StatusSlot::Tp, tp);
        statusRow.show(StatusSlot::Ta, ta);
    }
    /// The PI of the network, which leads all its commands.
    std::string heldPi() const {
        EXPECT_EQ(state.eonIdentifier, network.pi);
        return network.pi;
    }
    /// What is held of the network, told by what sending the whole data set sends after the removal of others.
    Lines held() {
        sent();
        Steps steps;
        network.appendSteps(steps);
        for (std::size_t i = 2; i < steps.size(); ++i) params.SendParam(steps[i].key, steps[i].value);
        return sent();
    }
    Lines rows() { return rowsOf(*find<QListWidget>("AFB_Liste")); }
    int chosenList() {
        for (int i = 0; i < 5; ++i) {
            if (checked(("EON_AFB_Opt_" + std::to_string(i)).c_str())) return i;
        }
        return -1;
    }
    int chosenType() { return find<QComboBox>("EON_PTY_Combo")->currentIndex(); }
    Ticker& timer() { return *find<Ticker>("EON_TA_Zeit"); }

    static constexpr const char* kSet = "Datenset1.INI";
    OtherNetwork network;
    std::unique_ptr<EonPage> page;
};

}  // namespace kdx::test
