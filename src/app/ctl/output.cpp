#include "app/ctl/output.h"

#include <cstdio>

#include "app/ctl/call.h"
#include "app/platform.h"
#include "settings/shownpath.h"

namespace kdx::ctl {

void Output::line(const std::string& text) const {
    if (m_call.json) return;
    std::puts(text.c_str());
    if (m_call.verbose) std::fflush(stdout);  // what happens is seen when it happens, also through a pipe
}

void Output::remark(const std::string& text) const {
    if (!m_call.quiet) line(text);
}

void Output::problem(const std::string& problem) {
    // Names and values come from the command line and from files, with any bytes in them.
    const std::string text = shownPath(problem);
    endProgress();
    std::fflush(stdout);
    std::fprintf(stderr, "kdx-ctl: %s\n", text.c_str());
    document["problems"].push_back(text);
}

void Output::progress(std::size_t number, std::size_t total) {
    if (m_call.quiet || m_call.verbose || !errorIsTerminal()) return;
    std::fprintf(stderr, "\rcommand %zu of %zu ", number, total);
    m_progressShown = true;
}

void Output::endProgress() {
    if (m_progressShown) std::fputs("\r\033[K", stderr);
    m_progressShown = false;
}

void Output::finish(int exitCode) {
    endProgress();
    if (!m_call.json) return;
    document["exit_code"] = exitCode;
    std::puts(document.dump(2, ' ', false, nlohmann::json::error_handler_t::replace).c_str());
}

}  // namespace kdx::ctl
