#include "app/ctl/readings.h"

#include "app/ctl/output.h"
#include "base/codepage.h"
#include "base/split.h"

namespace kdx::ctl {

namespace {

std::string shown(const std::optional<std::string>& value) {
    return value ? "\"" + toUtf8(*value) + "\"" : "(none)";
}

nlohmann::json inDocument(const std::optional<std::string>& value) {
    return value ? nlohmann::json(toUtf8(*value)) : nlohmann::json();
}

}  // namespace

std::string nameOf(const std::string& key, const std::string& network) {
    return network.empty() ? key : key + " of " + network;
}

void tellDifferences(Output& output, const char* name, const Differences& differing) {
    nlohmann::json& listed = output.document[name] = nlohmann::json::array();
    Output::Rows rows;
    for (const auto& [key, network, wanted, present] : differing) {
        if (rows.empty()) rows.push_back({"setting", "file", "instrument", ""});
        rows.push_back({nameOf(key, network), shown(wanted), shown(present), meaningOf(key)});
        listed.push_back({{"setting", key},
                          {"network", network},
                          {"file", inDocument(wanted)},
                          {"instrument", inDocument(present)}});
    }
    output.table(rows);
}

void tellUnanswered(Output& output, const Readout& readout) {
    std::vector<std::string> names;
    for (const Reading& reading : unanswered(readout)) names.push_back(nameOf(reading.key, reading.network));
    if (names.empty()) return;
    output.document["unanswered"] = names;
    output.problem("the instrument gave no answer to " + joined(names, ", "));
}

}  // namespace kdx::ctl
