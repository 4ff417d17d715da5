#include <cstdio>
#include <utility>

#include "app/ctl/prompt.h"

namespace kdx::ctl {

/// The console edits a line by itself and remembers earlier ones; it completes nothing.
struct PromptedLines::Editor {
    std::string prompt;
    PipedLines lines;
};

PromptedLines::PromptedLines(std::string prompt, int stop, Completer /*completer*/)
    : m_editor(new Editor{std::move(prompt), PipedLines(stop)}) {}

PromptedLines::~PromptedLines() = default;

std::optional<Line> PromptedLines::next() {
    std::fputs(m_editor->prompt.c_str(), stdout);
    std::fflush(stdout);
    return m_editor->lines.next();
}

}  // namespace kdx::ctl
