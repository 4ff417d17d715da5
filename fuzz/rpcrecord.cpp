// Records of an RPC byte stream, the same however the network cuts it.
#include "harness.h"

#include "vxi11/rpcrecord.h"

namespace {

using kdx::fuzz::demand;
constexpr std::size_t kLongest = 100;

std::vector<std::string> recordsOf(std::string_view stream, std::size_t piece, bool& tooLong) {
    kdx::RecordReader reader(kLongest);
    std::vector<std::string> records;
    for (; !stream.empty() && !reader.tooLong(); stream.remove_prefix(std::min(piece, stream.size()))) {
        reader.feed(stream.substr(0, piece));
        while (auto record = reader.next()) records.push_back(std::move(*record));
    }
    tooLong = reader.tooLong();
    return records;
}

}  // namespace

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    FuzzedDataProvider input(data, size);
    const std::size_t piece = 1 + input.ConsumeIntegral<std::uint8_t>();
    const std::string stream = input.ConsumeRemainingBytesAsString();

    bool tooLong = false, tooLongInPieces = false;
    const auto records = recordsOf(stream, size + 1, tooLong);
    demand(records == recordsOf(stream, piece, tooLongInPieces), "pieces make the same records");
    demand(tooLong == tooLongInPieces, "a record is too long in pieces too");
    std::string again;
    for (const std::string& record : records) {
        demand(record.size() <= kLongest, "no record is longer than allowed");
        again += kdx::framed(record);
    }
    demand(records == recordsOf(again, piece, tooLong) && !tooLong, "records framed anew are the same");
    return 0;
}
