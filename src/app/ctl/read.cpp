#include <CLI/CLI.hpp>

#include <memory>

#include "app/ctl/laboratory.h"
#include "app/ctl/readings.h"
#include "base/codepage.h"
#include "base/paths.h"
#include "settings/profilefile.h"
#include "station/comparison.h"
#include "station/setupfile.h"

namespace kdx::ctl {

namespace {

/// Tells what does not come back when the file is applied. @returns false when a value would become another one.
bool tellNotKept(Laboratory& laboratory, const std::string& file, const Readout& readout) {
    Output& output = laboratory.output();
    const Profile source = Profile::ofFile(laboratory.data(), file);
    const NotKept lost = notKept(laboratory.data(), laboratory.captions(), source, readout);
    nlohmann::json& unsent = output.document["not_sent_by_a_data_set"] = nlohmann::json::object();
    Output::Rows rows;
    for (const Reading& reading : lost.unsent) {
        rows.push_back(
            {"  " + nameOf(reading.key, reading.network) + "=" + toUtf8(*reading.value), meaningOf(reading.key)});
        unsent[reading.key] = toUtf8(*reading.value);
    }
    if (!rows.empty()) output.line("no data set sends these:");
    output.table(rows);
    nlohmann::json& changed = output.document["not_kept"] = nlohmann::json::array();
    for (const auto& [key, network, wanted, present] : lost.changed) {
        output.problem(nameOf(key, network) + " is \"" + toUtf8(present.value_or("")) + "\" and does not come back: " +
                       (wanted ? "the file makes it \"" + toUtf8(*wanted) + "\"" : "a data set has no place for it"));
        changed.push_back(nameOf(key, network));
    }
    return lost.changed.empty();
}

int read(Laboratory& laboratory, const std::string& into) {
    const std::filesystem::path path = std::filesystem::absolute(pathFromUtf8(into));
    const std::string file = utf8Of(path);
    std::error_code error;
    const bool exists = std::filesystem::exists(path, error);
    const auto before = exists ? readFile(path) : std::string();
    if (!before || isUtf16(*before)) {
        laboratory.output().problem(file + " is there and is no settings file that can be read");
        return kWrongCall;
    }
    if (!laboratory.open()) return kNoConnection;
    const Readout readout = readOut(laboratory.session().instrument);
    laboratory.close();
    if (laboratory.result() != kDone) return laboratory.result();
    ProfileText text(*before);
    keep(readout, text);
    if (!replaceFile(path, text.bytes())) {
        laboratory.output().problem(file + " cannot be written");
        return kFailed;
    }
    laboratory.output().remark("written: " + file);
    tellUnanswered(laboratory.output(), readout);
    const bool allComesBack = tellNotKept(laboratory, file, readout);
    return allComesBack && unanswered(readout).empty() ? kDone : kDifferent;
}

}  // namespace

void addRead(CLI::App& app, Task& task) {
    auto into = std::make_shared<std::string>();
    CLI::App* command =
        app.add_subcommand("read", "Read the instrument back into a data-set file; what cannot be kept is named");
    command->add_option("--into", *into, "the file; what it holds besides stays")->required()->type_name("FILE");
    command->footer("Example: kdx-ctl read --into Bench.INI");
    command->callback([into, &task] { task = [into](Laboratory& laboratory) { return read(laboratory, *into); }; });
}

}  // namespace kdx::ctl
