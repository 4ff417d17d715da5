#include "app/ctl/completion.h"

#include <CLI/CLI.hpp>

#include "coder/keyfacts.h"
#include "coder/readback.h"

namespace kdx::ctl {

namespace {

std::vector<std::string> names(const CLI::App& commands) {
    std::vector<std::string> all;
    for (const CLI::App* command : commands.get_subcommands({})) all.push_back(command->get_name());
    return all;
}

std::vector<std::string> options(const CLI::App& command) {
    std::vector<std::string> all;
    for (const CLI::Option* option : command.get_options()) {
        for (const std::string& name : option->get_lnames()) all.push_back("--" + name);
    }
    return all;
}

std::vector<std::string> keys() {
    std::vector<std::string> all;
    for (const KeyFacts& facts : keyFacts()) all.push_back(std::string(facts.key) + "=");
    return all;
}

std::vector<std::string> readBackNames() {
    std::vector<std::string> all{"all"};
    for (const ReadBack& readBack : readBacks()) all.emplace_back(readBack.name);
    return all;
}

}  // namespace

const CLI::App* commandNamed(const CLI::App& commands, const std::string& name) {
    for (const CLI::App* command : commands.get_subcommands({})) {
        if (command->check_name(name)) return command;
    }
    return nullptr;
}

std::vector<std::string> completions(const CLI::App& commands, const std::string& begun) {
    const std::size_t first = begun.find_first_not_of(" \t");
    const std::size_t firstEnd = begun.find_first_of(" \t", first);
    const std::string word = begun.substr(begun.find_last_of(" \t") + 1);
    std::vector<std::string> all;
    if (first == std::string::npos || firstEnd == std::string::npos) {
        all = names(commands);
    } else {
        const std::string name = begun.substr(first, firstEnd - first);
        const CLI::App* command = commandNamed(commands, name);
        if (command == nullptr) return {};
        if (word.starts_with("-")) all = options(*command);
        if (name == "help") all = names(commands);
        if (name == "send" && !word.starts_with("-")) all = keys();
        if (name == "query" && !word.starts_with("-")) all = readBackNames();
    }
    std::erase_if(all, [&](const std::string& candidate) { return !candidate.starts_with(word); });
    return all;
}

}  // namespace kdx::ctl
