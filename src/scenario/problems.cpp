#include "scenario/problems.h"

#include <algorithm>
#include <tuple>

#include "base/codepage.h"
#include "base/printable.h"

namespace kdx::scenario {

namespace {

constexpr std::size_t kMostProblems = 50;
constexpr std::string_view kIndentation = " \t";
constexpr std::string_view kAllowedControls = "\t\n\r";

}  // namespace

void Problems::add(std::size_t at, Mistake mistake, std::vector<std::string> words) {
    if (m_found.size() >= kMostProblems) return;
    const std::string_view before = m_text.substr(0, std::min(at, m_text.size()));
    const std::size_t lineBegin = before.rfind('\n') + 1;  // 0 in the first line: npos + 1
    const auto lines = std::count(before.begin(), before.end(), '\n');
    const std::size_t column = characterCount(before.substr(lineBegin)) + 1;
    for (std::string& word : words) word = printable(word, '.');
    m_found.push_back({static_cast<std::size_t>(lines) + 1, column, sentence(mistake, words), mistake, words});
}

std::vector<Problem> Problems::inOrder() const {
    std::vector<Problem> all = m_found;
    std::stable_sort(all.begin(), all.end(), [](const Problem& left, const Problem& right) {
        return std::tie(left.line, left.column) < std::tie(right.line, right.column);
    });
    return all;
}

void addForeignBytes(Problems& problems) {
    const std::string_view text = problems.text();
    bool indents = true;
    for (std::size_t at = 0; at < text.size();) {
        const std::size_t length = characterLength(text.substr(at));
        if (length == 0) {
            problems.add(at, Mistake::NotUtf8);
            return;
        }
        if (isControl(text[at]) && kAllowedControls.find(text[at]) == std::string_view::npos)
            problems.add(at, Mistake::ControlCharacter);
        if (indents && text[at] == '\t') {
            problems.add(at, Mistake::TabIndents);
            indents = false;
        }
        if (kIndentation.find(text[at]) == std::string_view::npos) indents = text[at] == '\n';
        at += length;
    }
}

}  // namespace kdx::scenario
