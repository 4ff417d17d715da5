#include "app/ctl/prompt.h"

#include <histedit.h>

#include <algorithm>
#include <clocale>
#include <cstdio>
#include <cstdlib>
#include <cwchar>
#include <stdexcept>
#include <utility>

#include "app/platform.h"

namespace kdx::ctl {

/// The line editor of the system's library; its functions find this as their client data.
struct PromptedLines::Editor {
    std::string prompt;
    int stop;
    Completer completer;
    std::unique_ptr<History, decltype(&history_end)> history{history_init(), &history_end};
    std::unique_ptr<EditLine, decltype(&el_end)> line{el_init("kdx-ctl", stdin, stdout, stderr), &el_end};

    static Editor& of(EditLine* line) {
        Editor* editor = nullptr;
        el_get(line, EL_CLIENTDATA, &editor);
        return *editor;
    }
    static char* promptOf(EditLine* line) { return of(line).prompt.data(); }
    static int readCharacter(EditLine* line, wchar_t* character);
    static unsigned char complete(EditLine* line, int key);
};

/// @returns 1, or 0 at the input's end and when the user wants to stop.
int PromptedLines::Editor::readCharacter(EditLine* line, wchar_t* character) {
    std::mbstate_t state{};
    for (;;) {
        char byte = 0;
        if (readInput({&byte, 1}, of(line).stop).value_or(0) == 0) return 0;
        const std::size_t taken = std::mbrtowc(character, &byte, 1, &state);
        if (taken <= 1) return 1;
        if (taken == static_cast<std::size_t>(-1)) state = {};  // no character of the terminal: left out
    }
}

/// Completes as far as all candidates agree; where they do not, shows them.
unsigned char PromptedLines::Editor::complete(EditLine* line, int /*key*/) {
    const LineInfo* info = el_line(line);
    const std::string begun(info->buffer, info->cursor);
    std::vector<std::string> candidates = of(line).completer(begun);
    if (candidates.empty()) return CC_ERROR;
    std::string agreed = candidates.front();
    for (const std::string& candidate : candidates) {
        const auto apart = std::mismatch(agreed.begin(), agreed.end(), candidate.begin(), candidate.end());
        agreed.erase(apart.first, agreed.end());
    }
    const std::size_t wordLength = begun.size() - (begun.find_last_of(" \t") + 1);
    std::string added = agreed.substr(std::min(wordLength, agreed.size()));
    if (candidates.size() == 1 && !agreed.ends_with('=')) added += ' ';
    if (!added.empty()) return el_insertstr(line, added.c_str()) == 0 ? CC_REFRESH : CC_ERROR;
    std::putchar('\n');
    for (const std::string& candidate : candidates) std::printf("%s  ", candidate.c_str());
    std::putchar('\n');
    return CC_REDISPLAY;
}

PromptedLines::PromptedLines(std::string prompt, int stop, Completer completer) {
    // What is typed is UTF-8 whatever the user's language; numbers stay as they are.
    if (std::setlocale(LC_CTYPE, "") == nullptr || MB_CUR_MAX == 1) std::setlocale(LC_CTYPE, "C.UTF-8");
    m_editor = std::make_unique<Editor>(Editor{std::move(prompt), stop, std::move(completer)});
    EditLine* line = m_editor->line.get();
    if (line == nullptr) throw std::runtime_error("the terminal cannot be used for editing lines");
    el_set(line, EL_CLIENTDATA, m_editor.get());
    el_set(line, EL_PROMPT, &Editor::promptOf);
    el_set(line, EL_EDITOR, "emacs");
    el_set(line, EL_GETCFN, &Editor::readCharacter);
    HistEvent event{};
    constexpr int kRemembered = 1000;
    history(m_editor->history.get(), &event, H_SETSIZE, kRemembered);
    history(m_editor->history.get(), &event, H_SETUNIQUE, 1);
    el_set(line, EL_HIST, history, m_editor->history.get());
    el_set(line, EL_ADDFN, "kdx-complete", "completes the word", &Editor::complete);
    el_set(line, EL_BIND, "^I", "kdx-complete", nullptr);
}

PromptedLines::~PromptedLines() = default;

std::optional<Line> PromptedLines::next() {
    // The editor shows the prompt first and takes the terminal over then: what is typed at once would be read
    // otherwise.
    el_set(m_editor->line.get(), EL_PREP_TERM, 1);
    int length = 0;
    const char* typed = el_gets(m_editor->line.get(), &length);
    if (typed == nullptr || length <= 0) {
        std::putchar('\n');
        return std::nullopt;
    }
    std::string text(typed, static_cast<std::size_t>(length));
    HistEvent event{};
    if (text != "\n") history(m_editor->history.get(), &event, H_ENTER, text.c_str());
    if (text.ends_with('\n')) text.pop_back();
    return lineOf(std::move(text));
}

}  // namespace kdx::ctl
