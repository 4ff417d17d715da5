// The client's messages against those that the RPC library makes of the protocol's description.
#include "vxi11/messages.h"

#include "simserver/tirpcxdr.h"
#include "vxi11/numbers.h"

#include <gtest/gtest.h>
#include <rpc/pmap_prot.h>
#include <vxi11.h>

#include <limits>
#include <string>

namespace kdx::vxi11 {
namespace {

constexpr std::int32_t kLeast = std::numeric_limits<std::int32_t>::min();
constexpr std::int32_t kMost = std::numeric_limits<std::int32_t>::max();
constexpr std::uint32_t kAll = std::numeric_limits<std::uint32_t>::max();
const std::string kTexts[] = {"", "i", "in", "ins", "inst0", "gpib0,28", std::string(70000, '\xE4')};

TEST(Vxi11Messages, ProgramsAndProceduresAreThoseOfTheDescription) {
    EXPECT_EQ(kCore, std::uint32_t{DEVICE_CORE});
    EXPECT_EQ(kCoreVersion, std::uint32_t{DEVICE_CORE_VERSION});
    EXPECT_EQ(kCreateLink, std::uint32_t{create_link});
    EXPECT_EQ(kDeviceWrite, std::uint32_t{device_write});
    EXPECT_EQ(kDeviceRead, std::uint32_t{device_read});
    EXPECT_EQ(kDestroyLink, std::uint32_t{destroy_link});
    EXPECT_EQ(kPortMapper, std::uint32_t{PMAPPROG});
    EXPECT_EQ(kPortMapperVersion, std::uint32_t{PMAPVERS});
    EXPECT_EQ(kGetPort, std::uint32_t{PMAPPROC_GETPORT});
}

TEST(Vxi11Messages, GetPort) {
    EXPECT_EQ(getPortArguments(), toXdr<pmap>({DEVICE_CORE, DEVICE_CORE_VERSION, IPPROTO_TCP, 0}, xdr_pmap));
    for (const std::uint32_t port : {0U, 1U, 65535U, 65536U, kAll})
        EXPECT_EQ(portResult(toXdr<std::uint32_t>(port, xdr_uint32_t)), port);
}

TEST(Vxi11Messages, CreateLink) {
    for (std::string device : kTexts) {
        for (const bool locks : {false, true}) {
            EXPECT_EQ(argumentsOf(CreateLink{kLeast, locks, kAll, device}),
                      toXdr<Create_LinkParms>({kLeast, locks, kAll, device.data()}, xdr_Create_LinkParms, 70008));
        }
    }
    for (const std::int32_t number : {kLeast, -1, 0, 1, kMost}) {
        const auto read = createdLink(toXdr<Create_LinkResp>({number, number, 0xFEDC, kAll}, xdr_Create_LinkResp));
        ASSERT_TRUE(read);
        EXPECT_EQ(read->error, number);
        EXPECT_EQ(read->link, number);
        EXPECT_EQ(read->abortPort, 0xFEDC);
        EXPECT_EQ(read->maxReceive, kAll);
    }
}

TEST(Vxi11Messages, DeviceWrite) {
    for (std::string data : kTexts) {
        Device_WriteParms expected{kMost, kAll, 2000, kFlagWaitLock | kFlagEnd, {}};
        expected.data.data_len = static_cast<u_int>(data.size());
        expected.data.data_val = data.data();
        EXPECT_EQ(argumentsOf(DeviceWrite{kMost, kAll, 2000, kFlagWaitLock | kFlagEnd, data}),
                  toXdr(expected, xdr_Device_WriteParms, 70008));
    }
    for (const std::int32_t error : {kLeast, 0, 15}) {
        const auto read = deviceWritten(toXdr<Device_WriteResp>({error, kAll}, xdr_Device_WriteResp));
        ASSERT_TRUE(read);
        EXPECT_EQ(read->error, error);
        EXPECT_EQ(read->size, kAll);
    }
}

TEST(Vxi11Messages, DeviceRead) {
    EXPECT_EQ(argumentsOf(DeviceRead{-1, 60, 2000, kAll, kFlagTermChar, '\n'}),
              toXdr<Device_ReadParms>({-1, 60, 2000, kAll, kFlagTermChar, '\n'}, xdr_Device_ReadParms));
    for (std::string data : kTexts) {
        Device_ReadResp made{kIoTimeout, kReasonEnd | kReasonTermChar, {}};
        made.data.data_len = static_cast<u_int>(data.size());
        made.data.data_val = data.data();
        const std::string bytes = toXdr(made, xdr_Device_ReadResp, 70008);
        const auto read = deviceWasRead(bytes, data.size());
        ASSERT_TRUE(read);
        EXPECT_EQ(read->error, kIoTimeout);
        EXPECT_EQ(read->reason, kReasonEnd | kReasonTermChar);
        EXPECT_EQ(read->data, data);
        EXPECT_EQ(deviceWasRead(bytes, data.size() / 2).has_value(), data.empty()) << "more than was asked for";
    }
}

TEST(Vxi11Messages, DestroyLink) {
    for (const std::int32_t link : {kLeast, 0, kMost}) {
        EXPECT_EQ(destroyLinkArguments(link), toXdr<Device_Link>(link, xdr_Device_Link));
        EXPECT_EQ(errorResult(toXdr<Device_Error>({link}, xdr_Device_Error)), link);
    }
}

TEST(Vxi11Messages, ResultsThatAreCutOffAreNone) {
    const auto cutOff = [](std::string bytes, const auto& read) {
        EXPECT_TRUE(read(bytes));
        while (!bytes.empty()) {
            bytes.pop_back();
            EXPECT_FALSE(read(bytes)) << bytes.size();
        }
    };
    cutOff(std::string(4, '\0'), [](std::string_view bytes) { return portResult(bytes); });
    cutOff(std::string(16, '\0'), [](std::string_view bytes) { return createdLink(bytes); });
    cutOff(std::string(8, '\0'), [](std::string_view bytes) { return deviceWritten(bytes); });
    cutOff(std::string(11, '\0') + '\2' + "ab" + std::string(2, '\0'),
           [](std::string_view bytes) { return deviceWasRead(bytes, 60); });
    cutOff(std::string(4, '\0'), [](std::string_view bytes) { return errorResult(bytes); });
}

}  // namespace
}  // namespace kdx::vxi11
