#pragma once

#include "link/visa.h"

#include <string>

namespace kdx {

namespace visa {
constexpr VisaStatus kUnknownStatus = 1073676421;  // 3FFF0085: the status has no description
}  // namespace visa

/// Describes a status in words. Takes the status; gives kSuccess and its text, or kUnknownStatus and a text with the
/// number for one that our own implementations never give.
VisaStatus describeStatus(VisaStatus status, std::string& description);

}  // namespace kdx
