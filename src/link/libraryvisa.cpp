#include "link/libraryvisa.h"

#include "link/sharedlibrary.h"

#include <algorithm>
#include <array>
#include <cstdint>
#include <filesystem>

namespace kdx {

namespace {

/// The operations as the VISA standard declares them for C.
struct Operations {
    std::int32_t(KDX_LIBRARY_CALL* viOpenDefaultRM)(std::uint32_t* resourceManager);
    std::int32_t(KDX_LIBRARY_CALL* viOpen)(std::uint32_t resourceManager, char* resource, std::uint32_t accessMode,
                                           std::uint32_t openTimeout, std::uint32_t* session);
    std::int32_t(KDX_LIBRARY_CALL* viClose)(std::uint32_t object);
    std::int32_t(KDX_LIBRARY_CALL* viStatusDesc)(std::uint32_t object, std::int32_t status, char* description);
    std::int32_t(KDX_LIBRARY_CALL* viWrite)(std::uint32_t session, const unsigned char* bytes, std::uint32_t count,
                                            std::uint32_t* written);
    std::int32_t(KDX_LIBRARY_CALL* viRead)(std::uint32_t session, unsigned char* buffer, std::uint32_t size,
                                           std::uint32_t* count);
};

std::int32_t atMost(std::uint32_t count, std::size_t limit) {
    return static_cast<std::int32_t>(std::min<std::size_t>(count, limit));
}

/// The installed VISA library.
class LibraryVisa final : public Visa {
public:
    LibraryVisa(std::unique_ptr<SharedLibrary> library, const Operations& operations)
        : m_library(std::move(library)), m_call(operations) {}

    VisaStatus viOpenDefaultRM(VisaHandle& resourceManager) override {
        auto handle = static_cast<std::uint32_t>(resourceManager);
        const VisaStatus status = m_call.viOpenDefaultRM(&handle);
        resourceManager = static_cast<VisaHandle>(handle);
        return status;
    }

    VisaStatus viStatusDesc(VisaHandle object, VisaStatus status, std::string& description) override {
        std::array<char, 1024> text{};  // the standard asks for 256
        const VisaStatus result = m_call.viStatusDesc(static_cast<std::uint32_t>(object), status, text.data());
        text.back() = '\0';
        description = text.data();
        return result;
    }

    VisaStatus viOpen(VisaHandle resourceManager, const std::string& resource, std::uint32_t accessMode,
                      std::uint32_t openTimeoutMs, VisaHandle& session) override {
        std::string name = resource;  // the library may not promise to leave it alone
        auto handle = static_cast<std::uint32_t>(session);
        const VisaStatus status =
            m_call.viOpen(static_cast<std::uint32_t>(resourceManager), name.data(), accessMode, openTimeoutMs, &handle);
        session = static_cast<VisaHandle>(handle);
        return status;
    }

    VisaStatus viWrite(VisaHandle session, std::span<const char> bytes, std::int32_t& written) override {
        std::uint32_t count = 0;
        const VisaStatus status =
            m_call.viWrite(static_cast<std::uint32_t>(session), reinterpret_cast<const unsigned char*>(bytes.data()),
                           static_cast<std::uint32_t>(bytes.size()), &count);
        written = atMost(count, bytes.size());
        return status;
    }

    VisaStatus viRead(VisaHandle session, std::span<char> buffer, std::int32_t& count) override {
        std::uint32_t got = 0;
        const VisaStatus status =
            m_call.viRead(static_cast<std::uint32_t>(session), reinterpret_cast<unsigned char*>(buffer.data()),
                          static_cast<std::uint32_t>(buffer.size()), &got);
        count = atMost(got, buffer.size());
        return status;
    }

    VisaStatus viClose(VisaHandle object) override { return m_call.viClose(static_cast<std::uint32_t>(object)); }

private:
    std::unique_ptr<SharedLibrary> m_library;
    Operations m_call;
};

/// Looks one operation up; notes the name of a missing one.
template <class Function>
void find(const SharedLibrary& library, const char* name, Function& operation, std::string& missing) {
    operation = library.function<Function>(name);
    if (operation == nullptr) missing += (missing.empty() ? "" : ", ") + std::string(name);
}

std::unique_ptr<Visa> load(const std::filesystem::path& path, std::string& file, std::string& reason) {
    std::unique_ptr<SharedLibrary> library = SharedLibrary::load(path, reason);
    if (!library) return nullptr;
    Operations operations{};
    std::string missing;
    find(*library, "viOpenDefaultRM", operations.viOpenDefaultRM, missing);
    find(*library, "viOpen", operations.viOpen, missing);
    find(*library, "viClose", operations.viClose, missing);
    find(*library, "viStatusDesc", operations.viStatusDesc, missing);
    find(*library, "viWrite", operations.viWrite, missing);
    find(*library, "viRead", operations.viRead, missing);
    if (!missing.empty()) {
        reason = "not a VISA library, it lacks " + missing;
        return nullptr;
    }
    file = library->file();
    return std::make_unique<LibraryVisa>(std::move(library), operations);
}

/// A file that is there is meant as such, though the system would look for a bare name elsewhere.
std::filesystem::path asFile(const std::string& name) {
    std::error_code ignored;
    const std::filesystem::path path(name);
    return std::filesystem::exists(path, ignored) ? std::filesystem::absolute(path, ignored) : path;
}

}  // namespace

VisaLibrary loadFirstVisaLibrary(std::span<const std::string> names) {
    VisaLibrary result;
    for (const std::string& name : names) {
        std::string cause;
        result.visa = load(asFile(name), result.file, cause);
        if (result.visa) break;
        // The system's own message may begin with the name.
        if (!cause.starts_with(name)) cause.insert(0, name + ": ");
        if (!result.reason.empty()) result.reason += '\n';
        result.reason += cause;
    }
    return result;
}

VisaLibrary loadVisaLibrary(const std::string& path) {
    const std::vector<std::string> names = path.empty() ? usualVisaLibraryNames() : std::vector<std::string>{path};
    return loadFirstVisaLibrary(names);
}

}  // namespace kdx
