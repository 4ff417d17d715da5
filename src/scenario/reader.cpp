#include "scenario/reader.h"

#include <algorithm>
#include <array>
#include <span>

#include "scenario/stepreader.h"
#include "scenario/values.h"
#include "scenario/yamltree.h"

namespace kdx::scenario {

namespace {

constexpr std::array<std::string_view, 5> kWords = {"title", "data_set", "steps", "restore", "report"};

void readMember(const std::string& name, const YamlNode& value, Scenario& scenario, Values& values) {
    if (name == "title") {
        scenario.title = values.text(value, name).value_or("");
    } else if (name == "data_set") {
        if (const auto number = values.whole(value, name, 1, 5)) scenario.dataSet = static_cast<int>(*number);
    } else if (name == "steps") {
        scenario.actions = StepReader(values).steps(value);
    } else if (name == "restore") {
        scenario.restore = values.choice(value, name).value_or(false);
    } else {
        const auto file = values.text(value, name);
        if (file && file->empty()) values.wrong(value, Mistake::ReportName);
        scenario.report = file.value_or("");
    }
}

}  // namespace

Reading readScenario(std::string_view utf8, bool force, const Corrections& corrections) {
    Reading reading;
    Problems problems(utf8.starts_with(kUtf8Mark) ? utf8.substr(kUtf8Mark.size()) : utf8);
    if (utf8.size() > kLargestFile) {
        problems.add(0, Mistake::TooLarge, {std::to_string(kLargestFile / 1024)});
        return {{}, problems.inOrder()};
    }
    const YamlNode root = readYaml(problems);
    Values values(problems, force, corrections);
    if (root.kind == YamlNode::Kind::Map) {
        for (const auto& [name, value] : root.members) {
            if (isOneOf(kWords, name.text)) {
                readMember(name.text, value, reading.scenario, values);
            } else {
                values.wrong(name, Mistake::UnknownWord, {name.text, listed(kWords)});
            }
        }
        if (memberOf(root, "steps") == nullptr && problems.empty()) values.wrong(root, Mistake::NoSteps);
    } else if (problems.empty()) {
        values.wrong(root, Mistake::NoScenario);
    }
    reading.problems = problems.inOrder();
    return reading;
}

}  // namespace kdx::scenario
