#include <windows.h>

#include <cstdio>
#include <cstdlib>
#include <string>

#include "app/platform.h"

namespace kdx {

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
    return GetFileType(GetStdHandle(STD_ERROR_HANDLE)) == FILE_TYPE_CHAR;
}

bool inputIsTerminal() {
    return GetFileType(GetStdHandle(STD_INPUT_HANDLE)) == FILE_TYPE_CHAR;
}

bool outputIsTerminal() {
    return GetFileType(GetStdHandle(STD_OUTPUT_HANDLE)) == FILE_TYPE_CHAR;
}

bool isReadable(int /*descriptor*/) {
    return false;  // there is none: see endRequests
}

void waitReadable(int /*descriptor*/, std::chrono::milliseconds time) {
    Sleep(static_cast<DWORD>(time.count()));
}

std::optional<std::size_t> readInput(std::span<char> room, int /*unless*/) {
    DWORD got = 0;
    const HANDLE input = GetStdHandle(STD_INPUT_HANDLE);
    if (!ReadFile(input, room.data(), static_cast<DWORD>(room.size()), &got, nullptr)) return 0;  // closed
    return got;
}

void surviveBrokenPipes() {
    // There writing fails anyway.
}

int endRequests() {
    return -1;  // there the system closes the window
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
    SetConsoleOutputCP(CP_UTF8);
    SetConsoleCP(CP_UTF8);
}

bool outputIsLost() {
    return std::fflush(stdout) != 0 || std::ferror(stdout) != 0;
}

void forgetTypedInput() {
    FlushConsoleInputBuffer(GetStdHandle(STD_INPUT_HANDLE));  // fails, and does nothing, where it is no console
}

InputLine takeInputLine() {
    return InputLine::Ended;  // it cannot be asked without waiting: a pause ends the run, see --yes
}

}  // namespace kdx
