#pragma once

#include <gtest/gtest.h>

#include <chrono>
#include <deque>
#include <optional>
#include <string>
#include <vector>

#include "scenario/reader.h"
#include "scenario/runner.h"
#include "station/session.h"
#include "support/linkfixture.h"

namespace kdx::test {

/// A scenario played to a scripted instrument by a clock that only sleeps move. What goes on is written down as lines.
class PlayTest : public ::testing::Test,
                 protected Bench,
                 protected scenario::Attendant,
                 protected scenario::Watcher,
                 protected scenario::Restorer {
protected:
    PlayTest();

    static scenario::Scenario read(const std::string& text);
    scenario::Outcome play(const std::string& text, const scenario::RunOptions& options = {});
    /// From a step to a step; "" for the whole.
    static scenario::RunOptions part(const std::string& from, const std::string& until);

    bool goesOn() override;
    Return pressed() override;
    void forgetsTyped() override { ++forgotten; }
    void finishes() override { heard.emplace_back("finishes"); }
    void begins(const std::string& step, const scenario::Action& action) override;
    void happened(const scenario::Row& row) override;
    void waits(std::chrono::nanoseconds length) override;
    void reportLost() override { heard.emplace_back("report lost"); }
    void ended(const scenario::Outcome&) override { heard.emplace_back("ended"); }
    bool remember() override;
    std::optional<SettingCommands> commands() override;
    [[nodiscard]] Lines untold() const override { return silentBefore; }
    std::optional<Lines> changed() override { return Lines{}; }

    Session session{visa, state, data, captions, clock, [] {}};
    const scenario::Report* report = nullptr;
    std::chrono::steady_clock::time_point begin;
    std::optional<std::chrono::milliseconds> stopAt;  ///< somebody stops the run
    bool stopped = false;
    bool remembers = true;
    int silentRestores = 0;                         ///< how often it cannot be asked what it has now
    int forgotten = 0;                              ///< how often what was typed was thrown away
    Lines silentBefore;                             ///< keys whose values it does not remember
    std::deque<std::chrono::milliseconds> returns;  ///< when a person presses Return
    bool inputEnds = false;
    Lines begun;
    Lines heard;
    std::vector<scenario::Row> rows;
    std::vector<long> waited;
    std::vector<long> writtenAt;  ///< milliseconds since the begin

private:
    [[nodiscard]] long sinceBegin() const;

    TrafficListener m_listener{session.instrument, [this](const Traffic& traffic) {
                                   if (traffic.kind == Traffic::Kind::Written) writtenAt.push_back(sinceBegin());
                               }};
};

}  // namespace kdx::test
