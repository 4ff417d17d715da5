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
    void line(const std::string& text) const;
    /// A line that only tells how it goes; not with JSON, not when the call is to be quiet.
    void remark(const std::string& text) const;
    void problem(const std::string& text);
    /// What does not keep the call from being done.
    void warning(const std::string& text);
    using Rows = std::vector<std::vector<std::string>>;
    /// Lines of the result with their columns under each other.
    void table(const Rows& rows) const;
    /// A problem that is known already: for the document only.
    void note(const std::string& text) { document["problems"].push_back(text); }
    /// Which command of how many goes out; only while the standard error is a terminal.
    void progress(std::size_t number, std::size_t total);
    void endProgress();

    /// The document of --json; problems and the exit code are added to it.
    nlohmann::json document = nlohmann::json::object();
    /// Prints the document when the call wants it.
    void finish(int exitCode);

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
