#include "window/pages.h"

#include <array>

#include "af/aflist.h"
#include "af/afpage.h"
#include "af/eonpage.h"
#include "groups/grouppage.h"
#include "rds/querypage.h"
#include "rds/rdspage.h"
#include "rds/storepage.h"
#include "rds/testmode.h"
#include "station/station.h"
#include "stereo/rfpage.h"
#include "stereo/stereopage.h"
#include "tmc/tmcpage.h"
#include "window/hmenue.h"

namespace kdx {

namespace {

Page* makeStereo(const PageContext& with, Station& station, HMenue& window) {
    auto* page = new StereoPage(with, station.multiplex, new TestMode(with, nullptr), &window);
    QObject::connect(page, &StereoPage::setRdsStereoRequested, &window, &HMenue::SetRdsStereo);
    return page;
}

Page* makeRds(const PageContext& with, Station& station, HMenue& window) {
    return new RdsPage(with, station.programme, &window);
}

Page* makeAf(const PageContext& with, Station& station, HMenue& window) {
    return new AfPage(with, station.af, &window);
}

Page* makeGroups(const PageContext& with, Station& station, HMenue& window) {
    return new GroupPage(with, station.groups, &window);
}

Page* makeEon(const PageContext& with, Station& station, HMenue& window) {
    return new EonPage(with, station.otherNetwork, &window);
}

Page* makeQueries(const PageContext& with, Station& /*station*/, HMenue& window) {
    auto* page = new QueryPage(with, &window);
    QObject::connect(&window, &HMenue::sessionOpened, page, [page] { page->Fragen_Schalter(true); });
    QObject::connect(&window, &HMenue::readAllRequested, page, [page, &window] {
        window.showPage(*page);
        page->askAll();
    });
    return page;
}

Page* makeStore(const PageContext& with, Station& /*station*/, HMenue& window) {
    return new StorePage(with, &window);
}

Page* makeTmc(const PageContext& with, Station& /*station*/, HMenue& window) {
    auto* page = new TmcPage(with, &window);
    QObject::connect(&window, &HMenue::listsEdited, page, &TmcPage::reloadLists);
    return page;
}

Page* makeRf(const PageContext& with, Station& station, HMenue& window) {
    return new RfPage(with, station.carrier, &window);
}

// The pages that the AF editor is opened from are not the ones that choose its lists: their buttons choose them again.
constexpr std::array kRows = {PageRow{makeStereo, 10, "page-fm-stereo.md"},
                              PageRow{makeRds, 11, "page-rds.md"},
                              PageRow{makeAf, 12, "page-af-list.md"},
                              PageRow{makeGroups, 13, "page-groups.md", kAfKind},
                              PageRow{makeEon, 14, "page-eon.md"},
                              PageRow{makeQueries, 15, "page-query.md", kEonAfKind},
                              PageRow{makeStore, 16, "page-store.md"},
                              PageRow{makeTmc, 17, "page-tmc.md"},
                              PageRow{makeRf, 18, "page-rf.md"}};

}  // namespace

std::span<const PageRow> pageRows() {
    return kRows;
}

}  // namespace kdx
