#pragma once

#include <gtest/gtest.h>

#include <filesystem>
#include <functional>
#include <string>

#include "settings/captions.h"
#include "settings/folderlock.h"
#include "sim/simvisa.h"
#include "sim/virtualinstrument.h"
#include "support/windowtest.h"
#include "window/tour.h"

namespace kdx::test {

class TourTest : public ::testing::Test {
protected:
    TourTest() { folder.copyShipped(); }

    int tour(Visa& visa) {
        Session session(visa, state, data, captions, clock, [] {});
        TickerGroup tickers;
        const FolderClaim claim(data.path());
        HMenue window({session, state, data, captions, clock, dialogs, tickers, claim, QString(), QString(), [] {}});
        window.startUp();
        return makeTour(window, session.instrument, dialogs, pictures, print);
    }

    TempFolder folder;
    std::filesystem::path pictures = folder.path() / "pictures";
    DataFolder data{folder.path()};
    FakeClock clock;
    ProgramState state;
    Captions captions{data};
    Lines printed;
    std::function<void(const std::string&)> print = [this](const std::string& line) { printed.push_back(line); };
    TourDialogs dialogs{print};
};

}  // namespace kdx::test
