#include <CLI/CLI.hpp>

#include <algorithm>
#include <memory>

#include "app/ctl/laboratory.h"
#include "app/ctl/othernetwork.h"
#include "base/codepage.h"
#include "base/numbers.h"
#include "base/split.h"
#include "coder/readback.h"
#include "link/commandsequence.h"

namespace kdx::ctl {

namespace {

struct Query {
    std::vector<std::string> names;
    bool raw = false;
    std::optional<std::string> otherNetwork;
};

const ReadBack* readBackOf(const std::string& name) {
    const auto& all = readBacks();
    const auto found = std::find_if(all.begin(), all.end(),
                                    [&](const ReadBack& readBack) { return equalNoCase(readBack.name, name); });
    return found == all.end() ? nullptr : &*found;
}

/// Who asked for all of them cannot know which is which: further lines of the words stand under the first.
std::string named(std::string_view name, std::size_t longestName, const std::string& words) {
    std::string text;
    for (const std::string_view line : split(words, "\n")) {
        text += text.empty() ? padRight(name, longestName + 2) : '\n' + std::string(longestName + 2, ' ');
        text += line;
    }
    return text;
}

int query(Laboratory& laboratory, const Query& what) {
    std::vector<const ReadBack*> asked;
    for (const std::string& name : what.names) {
        if (name == "all") {
            for (const ReadBack& readBack : readBacks()) asked.push_back(&readBack);
        } else if (const ReadBack* readBack = readBackOf(name)) {
            asked.push_back(readBack);
        } else {
            laboratory.output().problem("there is no read-back " + name + "; kdx-ctl list queries names them");
            return kWrongCall;
        }
    }
    if (!laboratory.open()) return kNoConnection;
    Session& session = laboratory.session();
    if (what.otherNetwork) laboratory.state().eonIdentifier = *what.otherNetwork;
    const bool all = std::find(what.names.begin(), what.names.end(), "all") != what.names.end();
    std::size_t longestName = 0;
    for (const ReadBack* readBack : asked) longestName = std::max(longestName, std::string_view(readBack->name).size());
    nlohmann::json& answered = laboratory.output().document["answers"] = nlohmann::json::object();
    std::size_t questions = 0;
    for (const ReadBack* readBack : asked) questions += readBack->queries(laboratory.state().eonIdentifier).size();
    laboratory.expect(questions);
    for (const ReadBack* readBack : asked) {
        if (!laboratory.goesOn()) break;
        const CommandSequence sequence(session.instrument);
        const auto answers = ask(session.instrument, *readBack, laboratory.state().eonIdentifier);
        nlohmann::json bare = nlohmann::json::array();
        for (const std::string& answer : answers) bare.push_back(toUtf8(answer));
        const std::string words =
            toUtf8(wordsOf(*readBack, answers, laboratory.captions(), laboratory.state().corrections));
        answered[readBack->name] = {{"words", words}, {"answers", bare}};
        if (what.raw) {
            for (const auto& answer : bare) laboratory.output().line(answer.get<std::string>());
        } else {
            laboratory.output().line(all ? named(readBack->name, longestName, words) : words);
        }
    }
    laboratory.close();
    return laboratory.result();
}

}  // namespace

void addQuery(CLI::App& app, Task& task) {
    auto what = std::make_shared<Query>();
    CLI::App* command = app.add_subcommand("query", "Read values back from the instrument, in words");
    command->add_option("names", what->names, "read-backs (kdx-ctl list queries), or all")
        ->required()
        ->type_name("NAME");
    command->add_flag("--raw", what->raw, "the bare answers, one a line");
    addOtherNetwork(*command, what->otherNetwork);
    command->footer("Example: kdx-ctl query ps pi rt");
    command->callback([what, &task] { task = [what](Laboratory& laboratory) { return query(laboratory, *what); }; });
}

}  // namespace kdx::ctl
