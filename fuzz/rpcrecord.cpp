// Records of an RPC byte stream, the same however the network cuts it.
#include "harness.h"

#include "vxi11/rpcrecord.h"

namespace {

using kdx::fuzz::demand;
constexpr std::size_t kLongest = 100;

std::vector<std::string> recordsOf(std::string_view stream, std::size_t piece, bool& broken) {
    kdx::RecordReader reader(kLongest);
    std::vector<std::string> records;
    for (; !stream.empty() && !reader.broken(); stream.remove_prefix(std::min(piece, stream.size()))) {
        reader.feed(stream.substr(0, piece));
        while (auto record = reader.next()) records.push_back(std::move(*record));
    }
    broken = reader.broken();
    return records;
}

}  // namespace

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    FuzzedDataProvider input(data, size);
    const std::size_t piece = 1 + input.ConsumeIntegral<std::uint8_t>();
    const std::string stream = input.ConsumeRemainingBytesAsString();

    bool broken = false, brokenInPieces = false;
    const auto records = recordsOf(stream, size + 1, broken);
    demand(records == recordsOf(stream, piece, brokenInPieces), "pieces make the same records");
    demand(broken == brokenInPieces, "a stream that is broken is so in pieces too");
    std::string again;
    for (const std::string& record : records) {
        demand(record.size() <= kLongest, "no record is longer than allowed");
        again += kdx::framed(record);
    }
    demand(records == recordsOf(again, piece, broken) && !broken, "records framed anew are the same");
    return 0;
}
