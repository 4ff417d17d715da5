#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "eonpagetest.h"

#include <algorithm>
#include <functional>
#include <ostream>

namespace kdx::test {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using ::testing::SizeIs;

template <typename Case>
std::string caseName(const ::testing::TestParamInfo<Case>& tested) {
    return tested.param.name;
}

TEST_F(EonPageTest, AnAnnouncementIsGivenForOneSecond) {
    load();
    click("EON_TA_Schalter");
    EXPECT_TRUE(checked("EON_TA_Schalter"));
    EXPECT_THAT(sent(), ElementsAre(direct("EON-TA=D3C2,1")));
    EXPECT_EQ(stored("EON_TA"), "1");
    EXPECT_TRUE(timer().isActive());
    EXPECT_EQ(timer().interval(), 1000);

    EXPECT_TRUE(tick("EON_TA_Zeit"));
    EXPECT_FALSE(checked("EON_TA_Schalter"));
    EXPECT_THAT(sent(), ElementsAre(direct("EON-TA=D3C2,0")));
    EXPECT_EQ(stored("EON_TA"), "0");
    EXPECT_FALSE(timer().isActive());
}

TEST_F(EonPageTest, ASecondClickEndsTheAnnouncementBeforeItsTime) {
    load();
    click("EON_TA_Schalter");
    click("EON_TA_Schalter");
    EXPECT_THAT(sent(), ElementsAre(direct("EON-TA=D3C2,1"), direct("EON-TA=D3C2,0")));
    EXPECT_FALSE(timer().isActive());
}

/// A language with its words and what the indicators read.
struct RefusalCase {
    const char* name;
    const char* language;
    const char* tp;
    const char* ta;
    int caption;  ///< text of the box; 0 when the announcement is given
    friend void PrintTo(const RefusalCase& refused, std::ostream* out) { *out << refused.name; }
};

class EonTaRefusal : public EonPageTest, public ::testing::WithParamInterface<RefusalCase> {};

TEST_P(EonTaRefusal, DependsOnTheOwnProgrammesIndicators) {
    const RefusalCase& the = GetParam();
    useLanguage(the.language);
    load();
    indicate(the.tp, the.ta);
    dialogs.expectedMessages = the.caption == 0 ? 0 : 1;
    click("EON_TA_Schalter");
    if (the.caption == 0) {
        EXPECT_THAT(sent(), ElementsAre(direct("EON-TA=D3C2,1")));
        return;
    }
    ASSERT_THAT(dialogs.shown, SizeIs(1));
    EXPECT_EQ(dialogs.shown[0].icon, Dialogs::Icon::Exclamation);
    EXPECT_EQ(toBytes(dialogs.shown[0].title), captions.text(167));
    EXPECT_EQ(toBytes(dialogs.shown[0].text), captions.text(the.caption));
    EXPECT_THAT(sent(), IsEmpty());
    EXPECT_EQ(stored("EON_TA"), "");
    EXPECT_FALSE(checked("EON_TA_Schalter"));
    EXPECT_FALSE(timer().isActive());
}

INSTANTIATE_TEST_SUITE_P(
    Indicators, EonTaRefusal,
    ::testing::Values(RefusalCase{"GivenInGerman", "deutsch", "aus", "ein", 0},
                      RefusalCase{"OwnTpOnInGerman", "deutsch", "ein", "ein", 168},
                      RefusalCase{"OwnTaOffInGerman", "deutsch", "aus", "aus", 169},
                      RefusalCase{"OwnTpIsToldFirst", "deutsch", "ein", "aus", 168},
                      RefusalCase{"GivenInEnglish", "english", "off", "on", 0},
                      RefusalCase{"OwnTpOnInEnglish", "english", "on", "on", 168},
                      RefusalCase{"OwnTaOffInEnglish", "english", "off", "off", 169},
                      RefusalCase{"UsEnglishHasTheEnglishWords", "english US", "on", "on", 168},
                      RefusalCase{"UsEnglishOffWord", "english US", "off", "off", 169},
                      // Only the words of the current language count: the indicators' design texts are none of them.
                      RefusalCase{"OtherLanguagesWords", "deutsch", "on", "off", 0},
                      RefusalCase{"DesignTexts", "deutsch", "Label1", "TA", 0}),
    caseName<RefusalCase>);

TEST_F(EonPageTest, WithoutTheOthersTrafficProgrammeNothingHappensAndNothingIsSaid) {
    store("EON_TP", "0");
    load();
    click("EON_TA_Schalter");
    EXPECT_THAT(sent(), IsEmpty());
    EXPECT_EQ(stored("EON_TA"), "");
    EXPECT_FALSE(checked("EON_TA_Schalter"));
    EXPECT_FALSE(timer().isActive());
}

TEST_F(EonPageTest, TheOwnProgrammesStateIsToldBeforeTheOthersTrafficProgrammeCounts) {
    store("EON_TP", "0");
    load();
    indicate("ein", "ein");
    dialogs.expectedMessages = 1;
    click("EON_TA_Schalter");
    ASSERT_THAT(dialogs.shown, SizeIs(1));
    EXPECT_EQ(toBytes(dialogs.shown[0].text), captions.text(168));
}

TEST_F(EonPageTest, ARunningAnnouncementThatIsNoLongerAllowedIsRefusedAtEveryTickUntilItIs) {
    load();
    click("EON_TA_Schalter");
    sent();
    indicate("ein", "ein");
    dialogs.expectedMessages = 2;
    EXPECT_TRUE(tick("EON_TA_Zeit"));
    EXPECT_TRUE(tick("EON_TA_Zeit"));
    EXPECT_THAT(dialogs.shown, SizeIs(2));
    EXPECT_THAT(sent(), IsEmpty());
    EXPECT_TRUE(checked("EON_TA_Schalter"));

    indicate("aus", "ein");
    EXPECT_TRUE(tick("EON_TA_Zeit"));
    EXPECT_THAT(sent(), ElementsAre(direct("EON-TA=D3C2,0")));
    EXPECT_FALSE(tick("EON_TA_Zeit"));
}

TEST_F(EonPageTest, WhenTheOthersTrafficProgrammeEndsTheTimerWaitsQuietly) {
    load();
    click("EON_TA_Schalter");
    click("EON_TP_Check");
    sent();
    EXPECT_TRUE(tick("EON_TA_Zeit"));
    EXPECT_THAT(sent(), IsEmpty());
    EXPECT_TRUE(timer().isActive());
    click("EON_TP_Check");
    sent();
    EXPECT_TRUE(tick("EON_TA_Zeit"));
    EXPECT_THAT(sent(), ElementsAre(direct("EON-TA=D3C2,0")));
}

/// Boxes that stay open for a while: the timers tick on meanwhile.
class SlowDialogs final : public Dialogs {
public:
    void message(Icon, const QString&, const QString&, const QString&) override { show(); }
    bool messageOrStop(const QString&, const QString&, const QString&, const QString&, Icon) override {
        show();
        return false;
    }
    bool confirm(const QString&, const QString&) override { return false; }
    QString input(const QString&, const QString&, const QString&) override { return {}; }

    void show() {
        ++open;
        ++boxes;
        mostOpen = std::max(mostOpen, open);
        if (open < 5) whileOpen();
        --open;
    }

    std::function<void()> whileOpen;
    int open = 0;
    int mostOpen = 0;
    int boxes = 0;
};

TEST_F(EonPageTest, ATickWhileARefusalIsOpenOpensNoSecondBox) {
    SlowDialogs slow;
    slow.whileOpen = [this] { tick("EON_TA_Zeit"); };
    makePage({params, instrument, settings, state, statusRow, captions, slow, data, clock, tickers, marks});
    load();
    click("EON_TA_Schalter");
    indicate("ein", "ein");
    tick("EON_TA_Zeit");
    EXPECT_EQ(slow.mostOpen, 1);
    tick("EON_TA_Zeit");
    EXPECT_EQ(slow.boxes, 2) << "the tick after the box was closed tells again";
}

TEST_F(EonPageTest, AnAnnouncementThatTheDataSetHoldsIsHeldWhileTheSwitchShowsOff) {
    store("EON_TA", "1");
    load();
    EXPECT_FALSE(checked("EON_TA_Schalter"));
    EXPECT_FALSE(timer().isActive());
    EXPECT_EQ(held().at(1), direct("EON-TA=D3C2,1"));
    click("EON_TA_Schalter");
    EXPECT_THAT(sent(), ElementsAre(direct("EON-TA=D3C2,0")));
    EXPECT_FALSE(checked("EON_TA_Schalter"));
}

TEST_F(EonPageTest, AnyOtherStoredAnnouncementCountsAsNone) {
    for (const char* value : {"", "0", "ein", "11"}) {
        store("EON_TA", value);
        startUp();
        EXPECT_EQ(held().at(1), direct("EON-TA=D3C2,0")) << value;
    }
}

}  // namespace
}  // namespace kdx::test
