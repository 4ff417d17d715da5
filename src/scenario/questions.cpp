#include "scenario/questions.h"

#include <algorithm>
#include <array>
#include <string_view>
#include <utility>

#include "base/split.h"
#include "link/coderquestion.h"
#include "link/commandsequence.h"
#include "scenario/decimal.h"

namespace kdx::scenario {

namespace {

// What the coder can be asked besides the questions of the read-backs.
constexpr std::array<std::string_view, 7> kFurther = {"TA", "TP", "RDS-PH", "RT-N", "BIN", "3A", "8A"};
// One value of the other network at work: its PI is added.
constexpr std::array<std::string_view, 4> kOfNetwork = {"EON-PS", "EON-PTY", "EON-TP", "EON-TA"};

template <typename Names>
bool holds(const Names& names, std::string_view name) {
    return std::find(names.begin(), names.end(), name) != names.end();
}

std::string withoutBlanks(std::string text) {
    text.erase(text.find_last_not_of(' ') + 1);
    return text;
}

std::string bareAnswer(std::string answer) {
    answer = withoutBlanks(std::move(answer));
    if (answer.size() < 2 || answer.front() != '"' || answer.back() != '"') return answer;
    return withoutBlanks(answer.substr(1, answer.size() - 2));
}

}  // namespace

std::optional<Question> questionOf(const std::string& name, const std::string& eonIdentifier) {
    for (const ReadBack& readBack : readBacks()) {
        if (name == readBack.name) return Question{readBack.queries(eonIdentifier), readBack.generator};
    }
    if (holds(kOfNetwork, name)) return Question{{{name + "?", name + "," + eonIdentifier}}};
    if (holds(kFurther, name)) return Question{{{name + "?", name}}};
    for (const ReadBack& readBack : readBacks()) {
        for (const Query& query : readBack.queries(eonIdentifier)) {
            if (query.key == name) return Question{{query}, readBack.generator};
        }
    }
    return std::nullopt;
}

std::vector<QuestionFacts> allQuestions() {
    std::vector<QuestionFacts> all;
    for (const ReadBack& readBack : readBacks()) {
        std::vector<std::string> parts;
        for (const Query& query : readBack.queries("PI")) parts.push_back(query.key);
        all.push_back({readBack.name, parts.size(), readBack.meaning, joined(parts, ", ")});
    }
    for (const std::string_view name : kFurther) all.push_back({std::string(name), 1, {}, std::string(name)});
    for (const std::string_view name : kOfNetwork)
        all.push_back({std::string(name), 1, "of the other network", std::string(name) + ",PI"});
    return all;
}

std::vector<std::string> ask(Instrument& instrument, const Question& question) {
    const CommandSequence sequence(instrument);
    std::vector<std::string> answers;
    for (const Query& query : question.queries) {
        const std::string asked = question.generator ? query.key + "?" : coderQuestion(query.key);
        answers.push_back(bareAnswer(instrument.ask(asked, false).value_or("")));
    }
    return answers;
}

bool isAnswer(const std::string& answer, const std::string& expected) {
    if (withoutBlanks(answer) == withoutBlanks(expected)) return true;
    const auto number = readDecimal(withoutBlanks(answer));
    return number && number == readDecimal(withoutBlanks(expected));
}

}  // namespace kdx::scenario
