#include <CLI/CLI.hpp>

#include <memory>

#include "app/ctl/laboratory.h"
#include "app/ctl/secondsoption.h"
#include "base/codepage.h"
#include "base/printable.h"
#include "link/discovery.h"
#include "link/lanresource.h"
#include "link/lanvisa.h"
#include "link/resource.h"
#include "link/visastatus.h"

namespace kdx::ctl {

namespace {

/// An instrument that was found, and how it is asked.
struct Found {
    std::string resource;
    std::string option;  ///< by which kdx-ctl reaches it
    Visa* visa;
};

/// What the VISA library lists on the LAN and the GPIB, unless it was found already.
void addListed(Visa& visa, std::vector<Found>& found) {
    for (const std::string& resource : visa.findResources()) {
        const Resource parts = parseResource(resource);
        if (!parts.wellFormed) continue;
        const bool onLan = parts.kind == Resource::Kind::Lan;
        const std::string address(parts.address);
        const bool known = std::any_of(found.begin(), found.end(), [&](const Found& other) {
            return onLan && other.resource == resourceText(Resource::Kind::Lan, address) &&
                   (parts.device.empty() || equalNoCase(parts.device, LanResource().device));
        });
        if (known) continue;
        std::string option = onLan ? "--lan " : "--gpib ";
        option += address;
        if (onLan && !parts.device.empty()) option.append(",").append(parts.device);
        found.push_back({resource, option, &visa});
    }
}

void tell(Laboratory& laboratory, const Found& instrument, std::vector<std::vector<std::string>>& rows) {
    const Identification said = identify(*instrument.visa, instrument.resource);
    const std::string text = toUtf8(printableLine(said.text, '.'));
    std::string words = text;
    if (text.empty()) {
        (void)describeStatus(said.status, words);
        words = "no answer to *IDN?: " + words;
    }
    rows.push_back({instrument.option, words});
    laboratory.output().document["instruments"].push_back(
        {{"resource", instrument.resource},
         {"option", instrument.option},
         {"identification", text.empty() ? nlohmann::json() : nlohmann::json(text)},
         {"status", said.status}});
}

int find(Laboratory& laboratory, std::chrono::milliseconds wait) {
    Output& output = laboratory.output();
    output.document["instruments"] = nlohmann::json::array();
    if (!laboratory.hasSession()) {
        (void)laboratory.open();  // which tells why
        return kNoConnection;
    }
    LanVisa lan(lanOptions(laboratory.call().program));
    Discovery how;
    how.wait = wait;
    how.stopped = [&laboratory] { return laboratory.isStopped(); };
    std::vector<Found> found;
    for (const std::string& address : discoverLanInstruments(how))
        found.push_back({resourceText(Resource::Kind::Lan, address), "--lan " + address, &lan});
    addListed(laboratory.visa(), found);
    std::vector<std::vector<std::string>> rows;
    for (const Found& instrument : found) {
        if (laboratory.isStopped()) break;
        tell(laboratory, instrument, rows);
    }
    output.table(rows);
    if (laboratory.isStopped()) return kFailed;
    if (!found.empty()) return kDone;
    output.problem(
        "no instrument answers in this machine's networks. One in another network, or behind a firewall that "
        "holds back UDP port 111, is reached by --lan and its address all the same.");
    return kNoConnection;
}

}  // namespace

void addFind(CLI::App& app, Task& task) {
    auto wait = std::make_shared<std::chrono::milliseconds>(1000);
    CLI::App* command = app.add_subcommand("find", "Look for instruments in this machine's networks (VXI-11)");
    using namespace std::chrono_literals;
    addSeconds(*command, {"--wait", 0s, 60s, "0 to 60", "how long to wait for answers, 0 to 60; else 1"},
               [wait](std::chrono::milliseconds time) { *wait = time; });
    command->footer(
        "Each is asked *IDN?. With a VISA library what that lists on the LAN and the GPIB is asked too. Exit code 4 "
        "when\n"
        "none is found.\n"
        "Example: kdx-ctl find --wait 3");
    command->callback([wait, &task] { task = [wait](Laboratory& laboratory) { return find(laboratory, *wait); }; });
}

}  // namespace kdx::ctl
