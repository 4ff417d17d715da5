#include <windows.h>

#include <string>

#include "settings/durablefile.h"
#include "settings/folderlock.h"

namespace kdx {

namespace {

constexpr int kMostClaims = 64;

/// A folder cannot be locked there, and a file to lock would be left behind in it. The system's named objects are the
/// claims instead, each program's another one: they go with the program that made them, also when it crashes. They bear
/// what the folder is, not its name, and are seen by the programs of one user's session.
std::wstring nameOf(const FileIdentity& folder, int claim) {
    return L"Local\\kdx-rds-" + std::to_wstring(folder.device) + L"-" + std::to_wstring(folder.number) + L"-" +
           std::to_wstring(claim);
}

}  // namespace

struct FolderClaim::Held {
    std::optional<FileIdentity> folder;
    int claim = kMostClaims;
    HANDLE object = nullptr;
};

FolderClaim::FolderClaim(const std::filesystem::path& folder) : m_held(new Held{identityOf(folder)}) {
    if (!m_held->folder) return;
    for (int claim = 0; claim < kMostClaims; ++claim) {
        const HANDLE object = CreateMutexW(nullptr, FALSE, nameOf(*m_held->folder, claim).c_str());
        if (object != nullptr && GetLastError() != ERROR_ALREADY_EXISTS) {
            m_held->claim = claim;
            m_held->object = object;
            return;
        }
        if (object != nullptr) CloseHandle(object);
    }
}

FolderClaim::~FolderClaim() {
    if (m_held->object != nullptr) CloseHandle(m_held->object);
}

bool FolderClaim::isShared() const {
    if (!m_held->folder) return false;
    for (int claim = 0; claim < kMostClaims; ++claim) {
        if (claim == m_held->claim) continue;
        if (const HANDLE other = OpenMutexW(SYNCHRONIZE, FALSE, nameOf(*m_held->folder, claim).c_str())) {
            CloseHandle(other);
            return true;
        }
    }
    return false;
}

}  // namespace kdx
