#pragma once

#include "rds/programme.h"
#include "rds/rdspage.h"
#include "support/pagetest.h"

namespace kdx::test {

/// The page "R D S" with its part of a data set, labelled and not loaded yet.
class RdsPageTest : public PageTest {
protected:
    RdsPageTest() { page.label(); }
    QWidget& root() override { return page; }

    /// What start-up does: the part reads the data set, the page shows it.
    void load() {
        programme.load(settings);
        page.load();
    }
    /// What sending the whole data set does with this page and its part.
    void sendProgramme() {
        Steps steps;
        programme.appendSteps(steps);
        programme.appendPtySteps(steps);
        for (const Step& step : steps) {
            page.stepGoesOut(step);
            params.SendParam(step.key, std::string(step.value));
        }
    }
    std::string stored(const std::string& key) const { return profile("Datenset1.INI", "RDS", key); }

    Programme programme;
    RdsPage page{context, programme, nullptr};
};

}  // namespace kdx::test
