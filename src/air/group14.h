#pragma once

/// Where groups 14A and 14B keep what they say about another network (IEC 62106, 6.1.5.20 and 6.1.5.21). Whoever
/// composes them and whoever reads them takes the places from here.
namespace kdx::air::group14 {

constexpr unsigned kTp = 0x10;
constexpr unsigned kTaOf14B = 0x08;
constexpr unsigned kVariant = 0x0F;

// Variants of 14A.
constexpr unsigned kLastOfPs = 3;
constexpr unsigned kMethodA = 4;
constexpr unsigned kFirstPair = 5;
constexpr unsigned kLastPair = 8;
constexpr unsigned kAmPair = 9;
constexpr unsigned kLinkage = 12;
constexpr unsigned kTypeAndTa = 13;
constexpr unsigned kItemNumber = 14;

constexpr unsigned kPtyPlace = 11;  ///< of the bits of the type in variant 13

}  // namespace kdx::air::group14
