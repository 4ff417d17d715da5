#include <array>

#include "settings/shippedfiles.h"

namespace kdx {

namespace {

// By packaging/shipped-versions.
// clang-format off
constexpr std::array kVersions = {
    ShippedVersion{"Event.txt", 10683, 0xfe5c92fe479ab190},
    ShippedVersion{"Event.txt", 26035, 0x68c4ff8afa910fac},
    ShippedVersion{"Location.txt", 1736, 0x8545a16a7aeb058b},
    ShippedVersion{"Sch_Off.ico", 15534, 0x897a4c937ff71acf},
    ShippedVersion{"Sch_On.ico", 15534, 0xde19655bb2b6ef00},
    ShippedVersion{"Sprachen.ini", 11462, 0xf1e1308787d5fdac},
    ShippedVersion{"Sprachen.ini", 12583, 0x63fcc388020ccfb3},
    ShippedVersion{"Sprachen.ini", 13495, 0x1de1a9bc034ffa53},
    ShippedVersion{"Sprachen.ini", 14023, 0x3e0d144cb22da06d},
    ShippedVersion{"Sprachen.ini", 14572, 0xedb554c33b741a17},
    ShippedVersion{"Sprachen.ini", 16543, 0x9022490f9bea724d},
    ShippedVersion{"Sprachen.ini", 18755, 0xdd91f5d5b2774756},
    ShippedVersion{"Sprachen.ini", 18850, 0xa09fd415a3f74107},
    ShippedVersion{"Sprachen.ini", 18856, 0xc02f35e281827041},
    ShippedVersion{"Sprachen.ini", 19050, 0xc3ad3c36b161dca6},
    ShippedVersion{"Sprachen.ini", 19368, 0xf27523b2a0e8fb36},
    ShippedVersion{"Sprachen.ini", 19496, 0x8a419e050344b4bd},
    ShippedVersion{"Sprachen.ini", 19684, 0xc6cef2f17092ddab},
    ShippedVersion{"Sprachen.ini", 26503, 0xbda45c36f8063ba6},
    ShippedVersion{"Sprachen.ini", 26691, 0x806237f21929ef38},
    ShippedVersion{"Sprachen.ini", 27622, 0xb6602d4f19a9c330},
    ShippedVersion{"Sprachen.ini", 27646, 0x0bad7e6a88576f8c},
    ShippedVersion{"Sprachen.ini", 27713, 0x6a569b4684e895b6},
    ShippedVersion{"Sprachen.ini", 28420, 0xecea8aa139390c85},
    ShippedVersion{"Sprachen.ini", 28598, 0xec84b3f56f2ce415},
    ShippedVersion{"Sprachen.ini", 28645, 0x13f8e04269488437},
    ShippedVersion{"Sprachen.ini", 28981, 0x853498ab8fe7a4bc},
    ShippedVersion{"Sprachen.ini", 29570, 0x3d4fa5171e9819fb},
    ShippedVersion{"Sprachen.ini", 29570, 0xd1fff2258019202f},
    ShippedVersion{"Sprachen.ini", 30198, 0x4a2296a77a788dcc},
    ShippedVersion{"Sprachen.ini", 30430, 0x6124218ed92059b2},
    ShippedVersion{"Sprachen.ini", 30430, 0x848e3269e9bd95b2},
    ShippedVersion{"Sprachen.ini", 44585, 0xba6d4b59549bd7b7},
    ShippedVersion{"Sprachen.ini", 44644, 0x4cd0274a4a2aaa67},
    ShippedVersion{"Sprachen.ini", 45540, 0xe753e65d70276d89},
    ShippedVersion{"Sprachen.ini", 49047, 0xc2b94c118c94ee3f},
    ShippedVersion{"Sprachen.ini", 52786, 0xfaeb8eb6c0264893},
    ShippedVersion{"Sprachen.ini", 55782, 0x988534a6c66e2079},
    ShippedVersion{"Sprachen.ini", 55782, 0xa8bf663276e23d35},
    ShippedVersion{"Sprachen.ini", 55914, 0x7c098493008808e7},
    ShippedVersion{"Sprachen.ini", 56025, 0xb809bd1f2f186579},
    ShippedVersion{"Sprachen.ini", 56093, 0xc7d9cdc6b04aef6f},
    ShippedVersion{"Sprachen.ini", 56469, 0x0c8fa61f15d3114c},
    ShippedVersion{"Sprachen.ini", 56648, 0xc4b49393d028b6d4},
    ShippedVersion{"Sprachen.ini", 56759, 0x3c7781f17d039ff2},
    ShippedVersion{"Sprachen.ini", 56895, 0x3eb6c27e3deb24d5},
    ShippedVersion{"Sprachen.ini", 57346, 0xd4a56bea6011dcb4},
    ShippedVersion{"Sprachen.ini", 57482, 0x8317c393d432fb8f},
    ShippedVersion{"Sprachen.ini", 64984, 0x0a0c51f7310d4141},
    ShippedVersion{"Sprachen.ini", 75613, 0x6e4cdde404679022},
    ShippedVersion{"Sprachen.ini", 76041, 0x414bdb7ab0455e5a},
    ShippedVersion{"Sprachen.ini", 78916, 0x4d101efaccb7c6e1},
    ShippedVersion{"Sprachen.ini", 78970, 0xce9bd37eed8d1aa4},
};
// clang-format on

}  // namespace

std::span<const ShippedVersion> shippedVersions() {
    return kVersions;
}

}  // namespace kdx
