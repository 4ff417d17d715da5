#pragma once

#include <filesystem>
#include <memory>
#include <string>

namespace kdx {

/// A library loaded at run time; it stays loaded as long as this object lives.
class SharedLibrary {
public:
    /// Loads a file, or a bare name from wherever the system keeps its libraries.
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
