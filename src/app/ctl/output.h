#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include <nlohmann/json.hpp>

namespace kdx::ctl {

struct Call;

/// What kdx-ctl tells: plain words as they come, or one JSON document at the end; problems always in words on the
/// standard error. Texts are UTF-8.
class Output {
public:
    explicit Output(const Call& call) : m_call(call) {}

    /// A line of the result; not with JSON.
    void line(const std::string& text);
    /// A line that only tells how it goes; not with JSON, not when the call is to be quiet.
    void remark(const std::string& text);
    void problem(const std::string& problem);
    /// What does not keep the call from being done.
    void warning(const std::string& text);
    using Rows = std::vector<std::vector<std::string>>;
    /// Lines of the result with their columns under each other.
    void table(const Rows& rows);
    /// A problem that is known already: for the document only.
    void note(const std::string& text) { document["problems"].push_back(text); }
    /// Which command of how many (0: nobody knows) goes out; only while the standard error is a terminal.
    void progress(std::size_t number, std::size_t total);
    /// Until when nothing happens; likewise.
    void waiting(const std::string& until);
    void endProgress();
    /// What is asked of the person at the program, whatever else the call wants shown.
    void prompt(const std::string& text);

    /// The document of --json; problems and the exit code are added to it.
    nlohmann::json document = nlohmann::json::object();
    /// Prints the document when the call wants it. @returns the exit code: another one when the result is lost.
    [[nodiscard]] int finish(int exitCode);

    /// From here on each line of input has a document of its own.
    void answerLines() { m_linewise = true; }
    /// What follows belongs to that line of input. @param place stands before its problems.
    void beginLine(std::size_t number, const std::string& place);
    /// Prints the line's document as one line, when the call wants it. False when nobody can read it any more.
    [[nodiscard]] bool endLine(int exitCode);

private:
    const Call& m_call;
    std::string m_place;
    bool m_linewise = false;
    bool m_progressShown = false;
};

}  // namespace kdx::ctl
