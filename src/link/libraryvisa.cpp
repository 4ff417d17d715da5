#include "link/libraryvisa.h"

#include "base/paths.h"
#include "link/sharedlibrary.h"
#include "link/visastatus.h"
#include "settings/shownpath.h"

#include <algorithm>
#include <array>
#include <cstdint>
#include <filesystem>

namespace kdx {

namespace {

/// The standard's unsigned and signed 32-bit arguments as they are handed over: as wide as a register, so that a
/// library whose types have 64 bits finds no rubbish in the upper half.
using Argument = std::uintptr_t;
using SignedArgument = std::intptr_t;

/// The operations as the VISA standard declares them for C.
struct Operations {
    std::int32_t(KDX_LIBRARY_CALL* viOpenDefaultRM)(std::uint32_t* resourceManager);
    std::int32_t(KDX_LIBRARY_CALL* viOpen)(Argument resourceManager, char* resource, Argument accessMode,
                                           Argument openTimeout, std::uint32_t* session);
    std::int32_t(KDX_LIBRARY_CALL* viClose)(Argument object);
    std::int32_t(KDX_LIBRARY_CALL* viStatusDesc)(Argument object, SignedArgument status, char* description);
    std::int32_t(KDX_LIBRARY_CALL* viWrite)(Argument session, const unsigned char* bytes, Argument count,
                                            std::uint32_t* written);
    std::int32_t(KDX_LIBRARY_CALL* viRead)(Argument session, unsigned char* buffer, Argument size,
                                           std::uint32_t* count);
    std::int32_t(KDX_LIBRARY_CALL* viFindRsrc)(Argument resourceManager, char* expression, std::uint32_t* list,
                                               std::uint32_t* count, char* description);
    std::int32_t(KDX_LIBRARY_CALL* viFindNext)(Argument list, char* description);
    std::int32_t(KDX_LIBRARY_CALL* viSetAttribute)(Argument object, Argument attribute, Argument value);
};

using AnswerTime = std::optional<std::chrono::milliseconds>;

constexpr Argument kTimeoutAttribute = 0x3FFF001A;  // VI_ATTR_TMO_VALUE, in milliseconds

/// Room for a number that the library gives back. A library whose types have 64 bits writes eight bytes, of which the
/// lower half is the number.
class Result {
public:
    explicit Result(std::uint32_t before = 0) : m_halves{before, 0} {}
    std::uint32_t* room() { return m_halves.data(); }
    [[nodiscard]] std::uint32_t value() const { return m_halves.front(); }
    [[nodiscard]] std::int32_t atMost(std::size_t limit) const {
        return static_cast<std::int32_t>(std::min<std::size_t>(value(), limit));
    }

private:
    alignas(std::uint64_t) std::array<std::uint32_t, 2> m_halves;
};

Argument argument(VisaHandle handle) {
    return static_cast<std::uint32_t>(handle);
}

/// The installed VISA library.
class LibraryVisa final : public Visa {
public:
    LibraryVisa(std::unique_ptr<SharedLibrary> library, const Operations& operations, AnswerTime answerTime)
        : m_library(std::move(library)), m_call(operations), m_answerTime(answerTime) {}

    VisaStatus viOpenDefaultRM(VisaHandle& resourceManager) override {
        Result handle(static_cast<std::uint32_t>(resourceManager));
        const VisaStatus status = m_call.viOpenDefaultRM(handle.room());
        resourceManager = static_cast<VisaHandle>(handle.value());
        return status;
    }

    VisaStatus viStatusDesc(VisaHandle object, VisaStatus status, std::string& description) override {
        if (m_call.viStatusDesc == nullptr) return describeStatus(status, description);
        std::array<char, 1024> text{};  // the standard asks for 256
        const VisaStatus result = m_call.viStatusDesc(argument(object), status, text.data());
        text.back() = '\0';
        description = text.data();
        return result;
    }

    VisaStatus viOpen(VisaHandle resourceManager, const std::string& resource, std::uint32_t accessMode,
                      std::uint32_t openTimeoutMs, VisaHandle& session) override {
        std::string name = resource;  // the library may not promise to leave it alone
        Result handle(static_cast<std::uint32_t>(session));
        const VisaStatus status =
            m_call.viOpen(argument(resourceManager), name.data(), accessMode, openTimeoutMs, handle.room());
        session = static_cast<VisaHandle>(handle.value());
        if (status < 0 || !m_answerTime) return status;
        const VisaStatus set =
            m_call.viSetAttribute(argument(session), kTimeoutAttribute, static_cast<Argument>(m_answerTime->count()));
        if (set < 0) viClose(session);
        return set < 0 ? set : status;
    }

    VisaStatus viWrite(VisaHandle session, std::span<const char> bytes, std::int32_t& written) override {
        Result count;
        const VisaStatus status =
            m_call.viWrite(argument(session), reinterpret_cast<const unsigned char*>(bytes.data()),
                           static_cast<std::uint32_t>(bytes.size()), count.room());
        written = count.atMost(bytes.size());
        return status;
    }

    VisaStatus viRead(VisaHandle session, std::span<char> buffer, std::int32_t& count) override {
        Result got;
        const VisaStatus status = m_call.viRead(argument(session), reinterpret_cast<unsigned char*>(buffer.data()),
                                                static_cast<std::uint32_t>(buffer.size()), got.room());
        count = got.atMost(buffer.size());
        return status;
    }

    std::vector<std::string> findResources() override {
        std::vector<std::string> found;
        VisaHandle manager = 0;
        if (m_call.viFindRsrc == nullptr || m_call.viFindNext == nullptr || viOpenDefaultRM(manager) < 0) return found;
        std::string expression = "?*INSTR";
        std::array<char, 1024> name{};  // the standard asks for 256
        Result list, count;
        VisaStatus status =
            m_call.viFindRsrc(argument(manager), expression.data(), list.room(), count.room(), name.data());
        const bool listed = status >= 0;
        constexpr std::size_t kMost = 1000;  // a library that never comes to an end
        for (; status >= 0 && found.size() < std::min<std::size_t>(kMost, count.value());
             status = m_call.viFindNext(list.value(), name.data())) {
            name.back() = '\0';
            found.emplace_back(name.data());
        }
        if (listed) m_call.viClose(list.value());
        viClose(manager);
        return found;
    }

    VisaStatus viClose(VisaHandle object) override { return m_call.viClose(argument(object)); }

private:
    std::unique_ptr<SharedLibrary> m_library;
    Operations m_call;
    AnswerTime m_answerTime;
};

/// Looks one operation up; notes the name of a missing one.
template <class Function>
void find(const SharedLibrary& library, const char* name, Function& operation, std::string& missing) {
    operation = library.function<Function>(name);
    if (operation == nullptr) missing += (missing.empty() ? "" : ", ") + std::string(name);
}

std::unique_ptr<Visa> load(const std::filesystem::path& path, AnswerTime answerTime, std::string& file,
                           std::string& reason) {
    std::unique_ptr<SharedLibrary> library = SharedLibrary::load(path, reason);
    if (!library) return nullptr;
    Operations operations{};
    std::string missing;
    find(*library, "viOpenDefaultRM", operations.viOpenDefaultRM, missing);
    find(*library, "viOpen", operations.viOpen, missing);
    find(*library, "viClose", operations.viClose, missing);
    find(*library, "viWrite", operations.viWrite, missing);
    find(*library, "viRead", operations.viRead, missing);
    if (answerTime) find(*library, "viSetAttribute", operations.viSetAttribute, missing);
    operations.viFindRsrc = library->function<decltype(operations.viFindRsrc)>("viFindRsrc");        // may lack
    operations.viFindNext = library->function<decltype(operations.viFindNext)>("viFindNext");        // may lack
    operations.viStatusDesc = library->function<decltype(operations.viStatusDesc)>("viStatusDesc");  // may lack
    if (!missing.empty()) {
        reason = "not a VISA library, it lacks " + missing;
        return nullptr;
    }
    file = library->file();
    return std::make_unique<LibraryVisa>(std::move(library), operations, answerTime);
}

}  // namespace

VisaLibrary loadFirstVisaLibrary(std::span<const std::string> names, AnswerTime answerTime) {
    VisaLibrary result;
    for (const std::string& name : names) {
        std::string cause;
        result.visa = load(pathFromUtf8(name), answerTime, result.file, cause);
        if (result.visa) break;
        // The system's own message may begin with the name.
        if (!cause.starts_with(name)) cause.insert(0, name + ": ");
        if (!result.reason.empty()) result.reason += '\n';
        result.reason += shownText(cause);  // the name in it may have any bytes
    }
    return result;
}

VisaLibrary loadVisaLibrary(const std::string& path, AnswerTime answerTime) {
    // The usual names stay bare: what lies in the folder that the program happens to be started in is not installed.
    if (path.empty()) return loadFirstVisaLibrary(usualVisaLibraryNames(), answerTime);
    return loadFirstVisaLibrary(std::array{utf8Of(fileOrSystemName(path))}, answerTime);
}

}  // namespace kdx
