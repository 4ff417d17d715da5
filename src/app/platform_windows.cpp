#include <windows.h>

#include <algorithm>
#include <array>
#include <condition_variable>
#include <cstdio>
#include <cstdlib>
#include <mutex>
#include <string>
#include <thread>
#include <utility>

#include "app/platform.h"

namespace kdx {

namespace {

constexpr int kEndRequests = 0;  // there are no descriptors for it: this one means the event
HANDLE endRequested = nullptr;

// The console is the user's: the next program there finds its letters as they were.
UINT outputBefore = 0, inputBefore = 0;
void giveCodePagesBack() {
    SetConsoleOutputCP(outputBefore);
    SetConsoleCP(inputBefore);
}

/// Whether the program has a console of its own, and is no program with windows.
bool belongsToConsole() {
    const auto* const image = reinterpret_cast<const char*>(GetModuleHandleW(nullptr));
    const auto* const dos = reinterpret_cast<const IMAGE_DOS_HEADER*>(image);
    const auto* const headers = reinterpret_cast<const IMAGE_NT_HEADERS*>(image + dos->e_lfanew);
    return headers->OptionalHeader.Subsystem == IMAGE_SUBSYSTEM_WINDOWS_CUI;
}

BOOL WINAPI noteEndRequest(DWORD kind) {
    SetEvent(endRequested);
    // The system ends the program as soon as this returns, but for these two.
    if (kind != CTRL_C_EVENT && kind != CTRL_BREAK_EVENT) Sleep(INFINITE);
    return TRUE;
}

/// Whether the stream is a console. Asked once: the system would answer only after a read that is under way.
bool isConsole(DWORD stream) {
    const auto answers = [](DWORD asked) {
        DWORD mode = 0;
        return GetConsoleMode(GetStdHandle(asked), &mode) != 0;
    };
    static const bool input = answers(STD_INPUT_HANDLE), output = answers(STD_OUTPUT_HANDLE),
                      error = answers(STD_ERROR_HANDLE);
    return stream == STD_INPUT_HANDLE ? input : stream == STD_OUTPUT_HANDLE ? output : error;
}

/// The standard input. Nobody can wait for it and for something else at once, nor ask it without waiting: a thread of
/// its own reads, a piece at a time.
class Input {
public:
    static Input& instance() {
        static auto* const one = new Input;  // the thread may wait in the system when the program ends
        return *one;
    }

    /// Becomes signalled when there is something, or the end of it.
    [[nodiscard]] HANDLE ready() const { return m_ready; }

    /// @returns how many bytes, 0 at the end; nothing when there are none yet.
    std::optional<std::size_t> take(std::span<char> room) {
        const std::lock_guard lock(m_mutex);
        if (m_piece.empty()) return m_ended ? std::optional<std::size_t>(0) : std::nullopt;
        const std::size_t count = std::min(room.size(), m_piece.size());
        std::copy_n(m_piece.begin(), count, room.begin());
        m_piece.erase(0, count);
        if (m_piece.empty()) letGoOn();
        return count;
    }
    void forget() {
        const std::lock_guard lock(m_mutex);
        if (m_piece.empty()) return;
        m_piece.clear();
        letGoOn();
    }

private:
    Input() {
        std::thread([this] { read(); }).detach();
    }

    void letGoOn() {
        ResetEvent(m_ready);
        m_taken.notify_one();
    }
    void read() {
        const bool console = isConsole(STD_INPUT_HANDLE);
        for (;;) {
            std::string piece = console ? typed() : piped();
            std::unique_lock lock(m_mutex);
            m_ended = piece.empty();
            m_piece = std::move(piece);
            SetEvent(m_ready);
            if (m_ended) return;
            m_taken.wait(lock, [this] { return m_piece.empty(); });
        }
    }
    static std::string piped() {
        std::string bytes(4096, '\0');
        DWORD got = 0;
        (void)ReadFile(GetStdHandle(STD_INPUT_HANDLE), bytes.data(), static_cast<DWORD>(bytes.size()), &got, nullptr);
        bytes.resize(got);
        return bytes;
    }
    /// A line as UTF-8: reading bytes the console gives NULs for letters beyond ASCII. Ctrl+Z begins the end.
    std::string typed() {
        std::array<wchar_t, 2048> letters;
        DWORD got = 0;
        do {
            SetLastError(ERROR_SUCCESS);
            const auto room = static_cast<DWORD>(letters.size()) - m_half;
            if (ReadConsoleW(GetStdHandle(STD_INPUT_HANDLE), letters.data() + m_half, room, &got, nullptr) == 0)
                return {};
        } while (got == 0 && GetLastError() == ERROR_OPERATION_ABORTED);  // Ctrl+C
        constexpr wchar_t kEnd = 0x1A;
        if (got == 0 || letters[m_half] == kEnd) return {};
        if (m_half > 0) letters[0] = m_firstHalf;
        got += m_half;
        m_firstHalf = letters[got - 1];
        m_half = IS_HIGH_SURROGATE(m_firstHalf) ? 1 : 0;  // the other half of the letter comes with the next piece
        got -= m_half;
        std::string bytes(3 * static_cast<std::size_t>(got), '\0');
        bytes.resize(static_cast<std::size_t>(WideCharToMultiByte(CP_UTF8, 0, letters.data(), static_cast<int>(got),
                                                                  bytes.data(), static_cast<int>(bytes.size()), nullptr,
                                                                  nullptr)));
        return bytes;
    }

    HANDLE m_ready = CreateEventW(nullptr, TRUE, FALSE, nullptr);
    std::mutex m_mutex;
    std::condition_variable m_taken;
    std::string m_piece;  ///< read and not taken yet
    bool m_ended = false;
    wchar_t m_firstHalf = 0;
    DWORD m_half = 0;
};

}  // namespace

std::filesystem::path programFolder(const char* /*program*/) {
    std::wstring name(32768, L'\0');  // the longest path there is
    name.resize(GetModuleFileNameW(nullptr, name.data(), static_cast<DWORD>(name.size())));
    return std::filesystem::path(name).parent_path();
}

std::filesystem::path userFolder() {
    const wchar_t* data = _wgetenv(L"APPDATA");
    return (data == nullptr ? std::filesystem::path() : std::filesystem::path(data)) / "KDX-RDS";
}

bool hasDisplay() {
    return true;
}

bool errorIsTerminal() {
    return isConsole(STD_ERROR_HANDLE);
}

bool inputIsTerminal() {
    return isConsole(STD_INPUT_HANDLE);
}

bool outputIsTerminal() {
    return isConsole(STD_OUTPUT_HANDLE);
}

bool isReadable(int descriptor) {
    return descriptor == kEndRequests && WaitForSingleObject(endRequested, 0) == WAIT_OBJECT_0;
}

void waitReadable(int descriptor, std::chrono::milliseconds time) {
    const auto length = static_cast<DWORD>(std::max<std::chrono::milliseconds::rep>(time.count(), 0));
    if (descriptor == kEndRequests)
        WaitForSingleObject(endRequested, length);
    else
        Sleep(length);
}

std::optional<std::size_t> readInput(std::span<char> room, int unless) {
    for (;;) {
        const std::array<HANDLE, 2> asked{Input::instance().ready(), endRequested};
        WaitForMultipleObjects(unless == kEndRequests ? 2 : 1, asked.data(), FALSE, INFINITE);
        if (isReadable(unless)) return std::nullopt;
        if (const auto got = Input::instance().take(room)) return got;
    }
}

void surviveBrokenPipes() {
    // There writing fails anyway.
}

int endRequests() {
    if (!belongsToConsole()) {
        SetConsoleCtrlHandler(nullptr, TRUE);  // what is broken off there has nothing to do with the window
        return -1;
    }
    endRequested = CreateEventW(nullptr, TRUE, FALSE, nullptr);
    SetConsoleCtrlHandler(noteEndRequest, TRUE);
    return kEndRequests;
}

void openStandardStreams() {}  // there a closed one is none: nothing takes its place

void useTerminal() {
    const auto isMissing = [](DWORD stream) {
        const HANDLE handle = GetStdHandle(stream);
        return handle == nullptr || handle == INVALID_HANDLE_VALUE;
    };
    // What the caller sends elsewhere stays there.
    const bool output = isMissing(STD_OUTPUT_HANDLE), error = isMissing(STD_ERROR_HANDLE);
    if ((output || error) && AttachConsole(ATTACH_PARENT_PROCESS)) {
        if (output && std::freopen("CONOUT$", "w", stdout) == nullptr) std::clearerr(stdout);
        if (error && std::freopen("CONOUT$", "w", stderr) == nullptr) std::clearerr(stderr);
    }
    outputBefore = GetConsoleOutputCP();
    inputBefore = GetConsoleCP();
    (void)std::atexit(giveCodePagesBack);
    SetConsoleOutputCP(CP_UTF8);
    SetConsoleCP(CP_UTF8);
    for (const DWORD stream : {STD_OUTPUT_HANDLE, STD_ERROR_HANDLE}) {
        DWORD mode = 0;
        if (isConsole(stream) && GetConsoleMode(GetStdHandle(stream), &mode) != 0)
            SetConsoleMode(GetStdHandle(stream),
                           mode | ENABLE_VIRTUAL_TERMINAL_PROCESSING);  // progress clears its line
    }
}

void leaveTerminal() {
    giveCodePagesBack();
    FreeConsole();
}

bool outputIsLost() {
    return std::fflush(stdout) != 0 || std::ferror(stdout) != 0;
}

void forgetTypedInput() {
    if (!inputIsTerminal()) return;
    FlushConsoleInputBuffer(GetStdHandle(STD_INPUT_HANDLE));
    Input::instance().forget();
}

InputLine takeInputLine() {
    constexpr int kMostAtOnce = 4096;  // whoever writes without end and without a line end holds nothing up
    for (int i = 0; i < kMostAtOnce; ++i) {
        char character = 0;  // one at a time: the rest is for the next call
        const auto got = Input::instance().take({&character, 1});
        if (!got) return InputLine::NotYet;
        if (*got == 0) return InputLine::Ended;
        if (character == '\n') return InputLine::Whole;
    }
    return InputLine::NotYet;
}

}  // namespace kdx
