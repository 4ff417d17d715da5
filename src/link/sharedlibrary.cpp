#include "link/sharedlibrary.h"

#ifdef _WIN32
#include <windows.h>
#else
#include <dlfcn.h>
#include <link.h>
#endif

#include <system_error>

namespace kdx {

#ifdef _WIN32

std::vector<std::string> usualVisaLibraryNames() {
    return sizeof(void*) == 8 ? std::vector<std::string>{"visa64.dll", "VISA32.DLL"}
                              : std::vector<std::string>{"VISA32.DLL"};
}

std::unique_ptr<SharedLibrary> SharedLibrary::load(const std::filesystem::path& file, std::string& reason) {
    // What a file needs besides may lie beside it; a bare name is not looked for in the current folder.
    const DWORD places =
        LOAD_LIBRARY_SEARCH_DEFAULT_DIRS | (file.is_absolute() ? DWORD{LOAD_LIBRARY_SEARCH_DLL_LOAD_DIR} : DWORD{0});
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
    wchar_t name[MAX_PATH] = {};
    GetModuleFileNameW(static_cast<HMODULE>(m_handle), name, MAX_PATH);
    return std::filesystem::path(name).string();
}

#else

std::vector<std::string> usualVisaLibraryNames() {
    return {"libvisa.so", "libvisa.so.0", "libktvisa32.so", "libiovisa.so"};
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
