#include "app/ctl/whichdataset.h"

#include <CLI/CLI.hpp>

#include "app/ctl/laboratory.h"

namespace kdx::ctl {

void WhichDataSet::addTo(CLI::App& command) {
    auto* set = command.add_option("--data-set", number, "the data set, 1 to 5")->check(CLI::Range(1, 5));
    command.add_option("--file", file, "any data-set file instead")->type_name("FILE")->excludes(set);
}

std::optional<Profile> WhichDataSet::profile(Laboratory& laboratory) const {
    // What is sent switches the carrier on: no set is taken unasked.
    if (!number && file.empty()) {
        laboratory.output().problem("which data set? --data-set N or --file FILE says it");
        return std::nullopt;
    }
    laboratory.state().CurrentDataSet = std::to_string(number.value_or(1));
    const std::string name =
        file.empty() ? dataSetFile(laboratory.state().CurrentDataSet) : std::filesystem::absolute(file).string();
    if (laboratory.data().profile(name)) return Profile::ofFile(laboratory.data(), name);
    laboratory.output().problem(name + " cannot be read");
    return std::nullopt;
}

}  // namespace kdx::ctl
