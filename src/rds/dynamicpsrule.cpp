#include "rds/dynamicpsrule.h"

#include <stdexcept>

#include "rds/programme.h"

namespace kdx {

namespace {

constexpr int kMostPages = 9;

}  // namespace

std::string nextScrollPs(DynamicPsRecord& record, const std::string& radiotext) {
    if (record.position > record.length) record.position = 0;
    ++record.position;
    record.length = static_cast<int>(radiotext.size());
    const std::string field = radiotext + std::string(kPsLength, ' ');
    const auto start = static_cast<std::size_t>(record.position - 1);
    return start < field.size() ? field.substr(start, kPsLength) : std::string();
}

std::string nextTogglePs(DynamicPsRecord& record, const std::string& typedPs) {
    record.ps = record.ps == kPsMarker ? typedPs : kPsMarker;
    return record.ps;
}

std::string nextPagePs(DynamicPsRecord& record, const std::string& radiotext) {
    record.length = static_cast<int>(radiotext.size() / kPsLength);
    // Pages 0 to that number would be cut out: a tenth has no place.
    if (record.length >= kMostPages) {
        throw std::out_of_range("Subscript out of range: the pages of a radiotext of 72 characters or more");
    }
    // The pages are not used any further: this mode blanks the PS on every step and is left exactly so.
    return {};
}

}  // namespace kdx
