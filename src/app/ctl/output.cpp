#include "app/ctl/output.h"

#include <algorithm>
#include <cstdio>

#include "app/ctl/call.h"
#include "app/platform.h"
#include "base/codepage.h"
#include "base/printable.h"
#include "settings/shownpath.h"

namespace kdx::ctl {

namespace {

/// The text with each control character but the line end as a point: what an instrument answers moves no cursor and
/// colours nothing.
std::string harmless(const std::string& text) {
    std::string result;
    for (std::size_t at = 0; at < text.size(); ++at) {
        const auto byte = static_cast<unsigned char>(text[at]);
        // Those of the code page beyond 7F are two bytes, C2 80 to C2 9F.
        const bool beyond = byte == 0xC2 && at + 1 < text.size() && static_cast<unsigned char>(text[at + 1]) < 0xA0;
        const bool control = (isControl(text[at]) && text[at] != '\n') || beyond;
        result += control ? '.' : text[at];
        if (beyond) ++at;
    }
    return result;
}

}  // namespace

void Output::line(const std::string& text) {
    if (m_call.json) return;
    endProgress();
    std::puts(harmless(text).c_str());
    if (m_call.verbose) std::fflush(stdout);  // what happens is seen when it happens, also through a pipe
}

void Output::remark(const std::string& text) {
    if (!m_call.quiet) line(text);
}

void Output::problem(const std::string& problem) {
    // Names and values come from the command line and from files, with any bytes in them.
    const std::string text = shownText(problem);
    endProgress();
    std::fflush(stdout);
    std::fprintf(stderr, "kdx-ctl: %s%s\n", m_place.c_str(), text.c_str());
    note(text);
}

void Output::warning(const std::string& text) {
    endProgress();
    std::fflush(stdout);
    std::fprintf(stderr, "warning: %s\n", harmless(text).c_str());
    document["warnings"].push_back(text);
}

void Output::table(const Rows& rows) {
    std::vector<std::size_t> widths;
    for (const auto& row : rows) {
        widths.resize(std::max(widths.size(), row.size()));
        for (std::size_t i = 0; i < row.size(); ++i) widths[i] = std::max(widths[i], characterCount(row[i]));
    }
    for (const auto& row : rows) {
        std::string text;
        for (std::size_t i = 0; i < row.size(); ++i) {
            text += row[i];
            if (i + 1 < row.size()) text += std::string(widths[i] - characterCount(row[i]) + 2, ' ');
        }
        line(text);
    }
}

void Output::progress(std::size_t number, std::size_t total) {
    if (m_call.quiet || m_call.verbose || !errorIsTerminal()) return;
    const std::string of = total == 0 ? std::string() : " of " + std::to_string(total);
    std::fprintf(stderr, "\rcommand %zu%s \033[K", number, of.c_str());
    m_progressShown = true;
}

void Output::waiting(const std::string& until) {
    if (m_call.quiet || m_call.verbose || !errorIsTerminal()) return;
    std::fprintf(stderr, "\rnext at %s \033[K", until.c_str());
    m_progressShown = true;
}

void Output::prompt(const std::string& text) {
    endProgress();
    std::fflush(stdout);
    std::fprintf(stderr, "%s\n", harmless(text).c_str());
}

void Output::endProgress() {
    if (m_progressShown) std::fputs("\r\033[K", stderr);
    m_progressShown = false;
}

int Output::finish(int exitCode) {
    endProgress();
    if (m_linewise) return exitCode;
    if (m_call.json) {
        document["exit_code"] = exitCode;
        std::puts(document.dump(2, ' ', false, nlohmann::json::error_handler_t::replace).c_str());
    }
    // Told at the end only: nothing that is being sent stops half-way for it.
    if (!outputIsLost()) return exitCode;
    problem("the output cannot be written");
    return exitCode == kDone || exitCode == kDifferent ? kFailed : exitCode;
}

void Output::beginLine(std::size_t number, const std::string& place) {
    document = {{"line", number}};
    m_place = place;
}

bool Output::endLine(int exitCode) {
    endProgress();
    m_place.clear();
    if (m_call.json) {
        document["exit_code"] = exitCode;
        std::puts(document.dump(-1, ' ', false, nlohmann::json::error_handler_t::replace).c_str());
    }
    return std::fflush(stdout) == 0 && std::ferror(stdout) == 0;
}

}  // namespace kdx::ctl
