#include "link/sharedlibrary.h"

#ifdef _WIN32
#include <windows.h>

#include "base/codepage.h"
#else
#include <dlfcn.h>
#include <link.h>
#endif

#include "base/paths.h"

#include <system_error>

namespace kdx {

#ifdef _WIN32

std::vector<std::string> usualVisaLibraryNames() {
    return sizeof(void*) == 8 ? std::vector<std::string>{"visa64.dll", "VISA32.DLL"}
                              : std::vector<std::string>{"VISA32.DLL"};
}

std::filesystem::path fileOrSystemName(const std::string& name) {
    const std::filesystem::path path = pathFromUtf8(name);
    for (const std::string& usual : usualVisaLibraryNames()) {
        if (equalNoCase(usual, name)) return path;
    }
    std::error_code ignored;
    return std::filesystem::exists(path, ignored) ? std::filesystem::absolute(path, ignored) : path;
}

std::unique_ptr<SharedLibrary> SharedLibrary::load(const std::filesystem::path& file, std::string& reason) {
    // A bare name is the system's own: whoever can put a file beside this program, as into a folder of downloads, must
    // not have it run. What a file needs besides may lie beside it.
    const DWORD places = file.is_absolute() ? LOAD_LIBRARY_SEARCH_DEFAULT_DIRS | LOAD_LIBRARY_SEARCH_DLL_LOAD_DIR
                                            : LOAD_LIBRARY_SEARCH_SYSTEM32;
    if (HMODULE handle = LoadLibraryExW(file.c_str(), nullptr, places)) {
        return std::unique_ptr<SharedLibrary>(new SharedLibrary(handle));
    }
    reason = std::system_category().message(static_cast<int>(GetLastError()));
    return nullptr;
}

SharedLibrary::~SharedLibrary() {
    FreeLibrary(static_cast<HMODULE>(m_handle));
}

void* SharedLibrary::address(const char* name) const {
    return reinterpret_cast<void*>(GetProcAddress(static_cast<HMODULE>(m_handle), name));
}

std::string SharedLibrary::file() const {
    std::wstring name(32768, L'\0');  // the longest path there is
    name.resize(GetModuleFileNameW(static_cast<HMODULE>(m_handle), name.data(), static_cast<DWORD>(name.size())));
    return utf8Of(name);
}

#else

std::vector<std::string> usualVisaLibraryNames() {
    return {"libvisa.so", "libvisa.so.0", "libktvisa32.so", "libiovisa.so"};
}

std::filesystem::path fileOrSystemName(const std::string& name) {
    std::error_code ignored;
    const std::filesystem::path path = pathFromUtf8(name);
    return std::filesystem::exists(path, ignored) ? std::filesystem::absolute(path, ignored) : path;
}

std::unique_ptr<SharedLibrary> SharedLibrary::load(const std::filesystem::path& file, std::string& reason) {
    // All at once: a library that lacks something itself must fail here and not in the middle of a measurement.
    if (void* const handle = dlopen(file.c_str(), RTLD_NOW | RTLD_LOCAL)) {
        return std::unique_ptr<SharedLibrary>(new SharedLibrary(handle));
    }
    const char* const why = dlerror();
    reason = why != nullptr ? why : "unknown reason";
    return nullptr;
}

SharedLibrary::~SharedLibrary() {
    dlclose(m_handle);
}

void* SharedLibrary::address(const char* name) const {
    return dlsym(m_handle, name);
}

std::string SharedLibrary::file() const {
    link_map* map = nullptr;
    return dlinfo(m_handle, RTLD_DI_LINKMAP, &map) == 0 ? map->l_name : std::string();
}

#endif

}  // namespace kdx
