#include <fcntl.h>
#include <poll.h>
#include <termios.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <system_error>

#include "app/platform.h"

namespace kdx {

namespace {

/// The variable's text; empty when it is not set.
std::filesystem::path variable(const char* name) {
    const char* value = std::getenv(name);
    return value == nullptr ? std::filesystem::path() : std::filesystem::path(value);
}

// A signal's handler knows nothing but what is global.
volatile std::sig_atomic_t requestSink = -1;

extern "C" void noteEndRequest(int /*signal*/) {
    const int before = errno;
    [[maybe_unused]] const ssize_t ignored = write(requestSink, "", 1);  // full: it was asked for already
    errno = before;
}

}  // namespace

std::filesystem::path programFolder(const char* program) {
    std::error_code error;
    const auto self = std::filesystem::canonical("/proc/self/exe", error);
    return (error ? std::filesystem::absolute(program, error) : self).parent_path();
}

std::filesystem::path userFolder() {
    // The XDG base directory standard: a relative path there is to be ignored. One in HOME is of no more use.
    if (const std::filesystem::path data = variable("XDG_DATA_HOME"); data.is_absolute()) return data / "kdx-rds";
    const std::filesystem::path home = variable("HOME");
    return home.is_absolute() ? home / ".local" / "share" / "kdx-rds" : std::filesystem::path();
}

bool hasDisplay() {
    return !variable("DISPLAY").empty() || !variable("WAYLAND_DISPLAY").empty() || !variable("QT_QPA_PLATFORM").empty();
}

bool errorIsTerminal() {
    return isatty(STDERR_FILENO) == 1;
}

bool inputIsTerminal() {
    return isatty(STDIN_FILENO) == 1;
}

bool outputIsTerminal() {
    return isatty(STDOUT_FILENO) == 1;
}

bool isReadable(int descriptor) {
    pollfd asked{descriptor, POLLIN, 0};
    return descriptor >= 0 && poll(&asked, 1, 0) == 1;
}

void waitReadable(int descriptor, std::chrono::milliseconds time) {
    using std::chrono::steady_clock;
    const auto end = steady_clock::now() + time;
    pollfd asked{descriptor, POLLIN, 0};  // a negative one is passed over
    for (;;) {
        const auto left = std::chrono::ceil<std::chrono::milliseconds>(end - steady_clock::now()).count();
        if (left <= 0 || poll(&asked, 1, static_cast<int>(left)) > 0) return;
    }
}

std::optional<std::size_t> readInput(std::span<char> room, int unless) {
    for (;;) {
        std::array asked{pollfd{STDIN_FILENO, POLLIN, 0}, pollfd{unless, POLLIN, 0}};
        if (poll(asked.data(), asked.size(), -1) < 0) {
            if (errno != EINTR) throw std::system_error(errno, std::generic_category(), "standard input");
            continue;
        }
        if (asked[1].revents != 0) return std::nullopt;
        const ssize_t got = read(STDIN_FILENO, room.data(), room.size());
        if (got >= 0) return static_cast<std::size_t>(got);
        if (errno != EINTR && errno != EAGAIN)
            throw std::system_error(errno, std::generic_category(), "standard input");
    }
}

void surviveBrokenPipes() {
    std::signal(SIGPIPE, SIG_IGN);
}

int endRequests() {
    std::array<int, 2> ends{};
    if (pipe(ends.data()) != 0) return -1;
    for (const int end : ends) {
        fcntl(end, F_SETFD, FD_CLOEXEC);
        fcntl(end, F_SETFL, O_NONBLOCK);
    }
    requestSink = ends[1];
    struct sigaction noting {};
    noting.sa_handler = noteEndRequest;
    noting.sa_flags = SA_RESTART;
    for (const int signal : {SIGTERM, SIGINT, SIGHUP}) {
        struct sigaction before {};
        sigaction(signal, nullptr, &before);
        // Who started the program with it switched off (nohup, a shell's background) wants it to live on.
        if (before.sa_handler != SIG_IGN) sigaction(signal, &noting, nullptr);
    }
    return ends[0];
}

void openStandardStreams() {
    for (const int stream : {STDIN_FILENO, STDOUT_FILENO, STDERR_FILENO}) {
        if (fcntl(stream, F_GETFD) >= 0) continue;
        // The lowest free number is this one.
        [[maybe_unused]] const int opened = open("/dev/null", stream == STDOUT_FILENO ? O_RDONLY : O_RDWR);
    }
}

void useTerminal() {}

void leaveTerminal() {}

bool outputIsLost() {
    if (std::fflush(stdout) == 0 && std::ferror(stdout) == 0) return false;
    pollfd asked{STDOUT_FILENO, POLLOUT, 0};
    return poll(&asked, 1, 0) < 0 || (asked.revents & POLLERR) == 0;
}

void forgetTypedInput() {
    if (inputIsTerminal()) tcflush(STDIN_FILENO, TCIFLUSH);
}

InputLine takeInputLine() {
    constexpr int kMostAtOnce = 4096;  // whoever writes without end and without a line end holds nothing up
    for (int i = 0; i < kMostAtOnce && isReadable(STDIN_FILENO); ++i) {
        char character = 0;  // one at a time: the next line is for who asks next
        const ssize_t got = read(STDIN_FILENO, &character, 1);
        if (got < 0 && (errno == EINTR || errno == EAGAIN)) return InputLine::NotYet;
        if (got <= 0) return InputLine::Ended;
        if (character == '\n') return InputLine::Whole;
    }
    return InputLine::NotYet;
}

}  // namespace kdx
