#include "app/ctl/whichdataset.h"

#include <CLI/CLI.hpp>

#include "app/ctl/laboratory.h"
#include "base/paths.h"
#include "rds/settings.h"

namespace kdx::ctl {

void WhichDataSet::addTo(CLI::App& command) {
    auto* set = command.add_option("--data-set", number, "the data set, 1 to 5")->check(CLI::Range(1, 5));
    const auto isName = [](const std::string& name) {
        return name.empty() ? std::string("it needs the name of a file") : std::string();
    };
    command.add_option("--file", file, "any data-set file instead")->check(isName)->type_name("FILE")->excludes(set);
}

std::optional<Profile> WhichDataSet::profile(Laboratory& laboratory) const {
    // What is sent switches the carrier on: no set is taken unasked.
    if (!isNamed()) {
        laboratory.output().problem("which data set? --data-set N or --file FILE says it");
        return std::nullopt;
    }
    laboratory.state().CurrentDataSet = std::to_string(number.value_or(1));
    const std::string name = file.empty() ? dataSetFile(laboratory.state().CurrentDataSet)
                                          : utf8Of(std::filesystem::absolute(pathFromUtf8(file)));
    if (!laboratory.data().profile(name)) {
        laboratory.output().problem(name + " cannot be read");
        return std::nullopt;
    }
    const auto source = Profile::ofFile(laboratory.data(), name);
    if (source.hasSectionOf(setting::kPi.place)) return source;
    laboratory.output().problem(name + " holds no data set: it has no section [" + setting::kPi.place.section + "]");
    return std::nullopt;
}

}  // namespace kdx::ctl
