#include <CLI/CLI.hpp>

#include <memory>

#include "app/ctl/laboratory.h"
#include "base/codepage.h"
#include "coder/keyfacts.h"
#include "coder/readback.h"
#include "rds/settings.h"
#include "scenario/questions.h"

namespace kdx::ctl {

namespace {

int listDataSets(Laboratory& laboratory) {
    Output::Rows rows;
    nlohmann::json& listed = laboratory.output().document["data_sets"] = nlohmann::json::array();
    for (int number = 1; number <= 5; ++number) {
        const std::string file = dataSetFile(std::to_string(number));
        if (!laboratory.data().profile(file)) continue;
        const Profile profile = Profile::ofFile(laboratory.data(), file);
        const std::string ps = toUtf8(profile.read(setting::kPs.place));
        const std::string pi = toUtf8(profile.read(setting::kPi.place));
        rows.push_back({std::to_string(number), ps, pi});
        listed.push_back({{"number", number}, {"ps", ps}, {"pi", pi}});
    }
    laboratory.output().table(rows);
    return kDone;
}

int listKeys(Laboratory& laboratory) {
    Output::Rows rows;
    nlohmann::json& listed = laboratory.output().document["keys"] = nlohmann::json::array();
    for (const KeyFacts& facts : keyFacts()) {
        rows.push_back({std::string(facts.key), std::string(facts.meaning), facts.range});
        listed.push_back({{"key", facts.key}, {"meaning", facts.meaning}, {"range", facts.range}});
    }
    laboratory.output().table(rows);
    return kDone;
}

int listQueries(Laboratory& laboratory) {
    Output::Rows rows;
    nlohmann::json& listed = laboratory.output().document["queries"] = nlohmann::json::array();
    for (const ReadBack& readBack : readBacks()) {
        rows.push_back({readBack.name, readBack.meaning});
        listed.push_back({{"name", readBack.name}, {"meaning", readBack.meaning}});
    }
    laboratory.output().table(rows);
    return kDone;
}

int listQuestions(Laboratory& laboratory) {
    Output::Rows rows{{"name", "answers", "what is asked", ""}};
    nlohmann::json& listed = laboratory.output().document["questions"] = nlohmann::json::array();
    for (const auto& [name, answers, meaning, asked] : scenario::allQuestions()) {
        rows.push_back({name, std::to_string(answers), asked, meaning});
        listed.push_back({{"name", name}, {"answers", answers}, {"meaning", meaning}, {"asked", asked}});
    }
    laboratory.output().table(rows);
    return kDone;
}

}  // namespace

void addList(CLI::App& app, Task& task) {
    CLI::App* command =
        app.add_subcommand("list", "List the data sets with PS and PI, the keys, the read-backs, or more questions");
    auto what = std::make_shared<std::string>("data-sets");
    command->add_option("what", *what, "data-sets, keys, queries, or questions: what a scenario can expect answers to")
        ->check(CLI::IsMember({"data-sets", "keys", "queries", "questions"}))
        ->type_name("WHAT");
    command->footer("Example: kdx-ctl list keys");
    command->callback([what, &task] {
        task = *what == "keys"        ? listKeys
               : *what == "queries"   ? listQueries
               : *what == "questions" ? listQuestions
                                      : listDataSets;
    });
}

}  // namespace kdx::ctl
