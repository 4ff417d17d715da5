#include "link/visastatus.h"

#include <algorithm>
#include <array>
#include <string_view>

namespace kdx {

namespace {

struct StatusText {
    VisaStatus status;
    std::string_view text;
};

constexpr std::array kStatusTexts = {
    StatusText{visa::kSuccess, "Operation completed successfully."},
    StatusText{visa::kMaxCountReached, "The number of bytes asked for has been read."},
    StatusText{visa::kTermCharacter, "The termination character has been read."},
    StatusText{visa::kSystemError, "Unknown system error."},
    StatusText{visa::kInvalidObject, "There is no such session."},
    StatusText{visa::kResourceLocked, "The resource is locked by somebody else."},
    StatusText{visa::kResourceNotFound, "No instrument was found at the address."},
    StatusText{visa::kInvalidResourceName, "The resource name cannot be read."},
    StatusText{visa::kTimeout, "The time-out expired before the operation completed."},
    StatusText{visa::kAborted, "The operation was aborted."},
    StatusText{visa::kInputOutput, "An error occurred in the transfer."},
    StatusText{visa::kLibraryNotFound, "No library was found that can serve the resource."},
    StatusText{visa::kConnectionLost, "The connection to the instrument was lost."},
};

}  // namespace

VisaStatus describeStatus(VisaStatus status, std::string& description) {
    const auto* const known = std::find_if(kStatusTexts.begin(), kStatusTexts.end(),
                                           [status](const StatusText& row) { return row.status == status; });
    if (known == kStatusTexts.end()) {
        description = "Unknown status " + std::to_string(status) + ".";
        return visa::kUnknownStatus;
    }
    description = known->text;
    return visa::kSuccess;
}

}  // namespace kdx
