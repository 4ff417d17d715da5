#pragma once

#include <filesystem>
#include <memory>
#include <string>
#include <vector>

/// How functions of the system's libraries are called.
#if defined(_WIN32) && !defined(_WIN64)
#define KDX_LIBRARY_CALL __stdcall
#else
#define KDX_LIBRARY_CALL
#endif

namespace kdx {

/// The file names under which VISA libraries are installed on this system, in the order in which they are tried.
[[nodiscard]] std::vector<std::string> usualVisaLibraryNames();

/// A file that is there is meant as such when the user names it, though the system would look for a bare name
/// elsewhere. On Windows the usual names stay bare: there the folder that the program is started in is nobody's choice.
[[nodiscard]] std::filesystem::path fileOrSystemName(const std::string& name);

/// A library loaded at run time; it stays loaded as long as this object lives.
class SharedLibrary {
public:
    /// Loads a file, or a bare name from wherever the system keeps its libraries (never from the current folder).
    /// Gives nothing and the system's reason when that fails.
    static std::unique_ptr<SharedLibrary> load(const std::filesystem::path& file, std::string& reason);
    ~SharedLibrary();
    SharedLibrary(const SharedLibrary&) = delete;
    SharedLibrary& operator=(const SharedLibrary&) = delete;

    /// The function of that name as the type the caller knows it has; null when there is none.
    template <class Function>
    [[nodiscard]] Function function(const char* name) const {
        return reinterpret_cast<Function>(address(name));
    }

    /// The file that was really loaded.
    [[nodiscard]] std::string file() const;

private:
    explicit SharedLibrary(void* handle) : m_handle(handle) {}
    [[nodiscard]] void* address(const char* name) const;

    void* m_handle;
};

}  // namespace kdx
