#pragma once

#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "app/ctl/lines.h"

namespace kdx::ctl {

/// Lines typed at a terminal, with a prompt, their history and completion: prompt_posix.cpp. On Windows the console has
/// a history of its own, and there is no completion: prompt_windows.cpp.
class PromptedLines final : public LineSource {
public:
    /// Gives what the last word of a line that was begun may become.
    using Completer = std::function<std::vector<std::string>(const std::string& begun)>;

    /// @param stop a descriptor that is readable once the user wants to stop: Ctrl-C, which ends the shell.
    PromptedLines(std::string prompt, int stop, Completer completer);
    ~PromptedLines() override;
    std::optional<Line> next() override;

private:
    struct Editor;
    std::unique_ptr<Editor> m_editor;
};

}  // namespace kdx::ctl
