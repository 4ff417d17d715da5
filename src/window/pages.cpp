#include "window/pages.h"

#include <array>

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

using MakePage = Page* (*)(const PageContext&, Station&, HMenue&);

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
    QObject::connect(&window, &HMenue::readAllRequested, page, &QueryPage::askAll);
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

constexpr std::array<MakePage, 9> kMakers = {makeStereo,  makeRds,   makeAf,  makeGroups, makeEon,
                                             makeQueries, makeStore, makeTmc, makeRf};

}  // namespace

std::vector<Page*> makePages(const PageContext& with, Station& station, HMenue& window) {
    std::vector<Page*> pages;
    pages.reserve(kMakers.size());
    for (const MakePage make : kMakers) pages.push_back(make(with, station, window));
    return pages;
}

}  // namespace kdx
