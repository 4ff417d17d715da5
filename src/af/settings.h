#pragma once

#include <array>

#include "settings/profile.h"

namespace kdx::setting {

// How the alternative frequencies and the other network are sent, and where they are kept.
inline constexpr std::array kAfLists{
    Setting{"AF1", {KeptIn::DataSet, "RDS", "AF_LISTE1"}}, Setting{"AF2", {KeptIn::DataSet, "RDS", "AF_LISTE2"}},
    Setting{"AF3", {KeptIn::DataSet, "RDS", "AF_LISTE3"}}, Setting{"AF4", {KeptIn::DataSet, "RDS", "AF_LISTE4"}},
    Setting{"AF5", {KeptIn::DataSet, "RDS", "AF_LISTE5"}}};
inline constexpr Place kShownAfList{KeptIn::DataSet, "RDS", "AF_LISTE"};  // its number

/// The question for the networks that the coder holds: the name it is logged under, and the coder's query text.
struct Question {
    const char* label;
    const char* key;
};
inline constexpr Question kHeldNetworks{"EON-PI", "EON PI?"};
inline constexpr Setting kEonPi{"EON_PI", {KeptIn::DataSet, "RDS", "EON_PI"}};
inline constexpr Setting kEonPs{"EON_PS", {KeptIn::DataSet, "RDS", "EON_PS"}};
// The chosen type's name goes out under the key of the PI, so that the coder gets its first 4 characters as one; the
// type itself never reaches it. Set-ups live with it.
inline constexpr Setting kEonPty{"EON_PI", {KeptIn::DataSet, "RDS", "EON_PTY"}};
// Its own key, under which its number goes out where that is corrected.
inline constexpr const char* kEonType = "EON_PTY";
inline constexpr Place kEonPtyShown{KeptIn::DataSet1, "RDS", "EON_PTY"};  // data set 1 whatever set is at work
inline constexpr Setting kEonTp{"EON_TP", {KeptIn::DataSet, "RDS", "EON_TP"}};
inline constexpr Setting kEonTa{"EON_TA", {KeptIn::DataSet, "RDS", "EON_TA"}};
inline constexpr std::array kEonAfLists{Setting{"EON_AFB1", {KeptIn::DataSet, "RDS", "EON_AFB1"}},
                                        Setting{"EON_AFB2", {KeptIn::DataSet, "RDS", "EON_AFB2"}},
                                        Setting{"EON_AFB3", {KeptIn::DataSet, "RDS", "EON_AFB3"}},
                                        Setting{"EON_AFB4", {KeptIn::DataSet, "RDS", "EON_AFB4"}},
                                        Setting{"EON_AFB5", {KeptIn::DataSet, "RDS", "EON_AFB5"}}};
inline constexpr Place kShownEonAfList{KeptIn::DataSet, "RDS", "EON_AFB"};  // its number
inline constexpr const char* kEonRemoval = "EON_DEL";  // "EON_DEL" of the data set is written by hand only and not used

}  // namespace kdx::setting
