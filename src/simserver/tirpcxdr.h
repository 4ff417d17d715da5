#pragma once

#include "vxi11/xdr.h"

#include <rpc/rpc.h>

#include <cstddef>
#include <cstdint>
#include <limits>
#include <string>
#include <string_view>

namespace kdx {

/// An XDR routine as the RPC library and its generator make them.
template <class Value>
using XdrRoutine = bool_t (*)(XDR*, Value*);

/// Stands for "no counted field" in XdrDecoded.
constexpr std::size_t kNoCount = std::numeric_limits<std::size_t>::max();

/// A value read from XDR, with the memory that belongs to it.
template <class Value>
class XdrDecoded {
public:
    /// @param countAt where the length word of a string or opaque field stands. The XDR routines trust that length when
    ///        they allocate, so one that points past the bytes is refused here first.
    XdrDecoded(std::string_view bytes, XdrRoutine<Value> routine, std::size_t countAt = kNoCount) : m_routine(routine) {
        if (countAt != kNoCount && !countFits(bytes, countAt)) return;
        XDR stream;
        xdrmem_create(&stream, const_cast<char*>(bytes.data()), static_cast<u_int>(bytes.size()), XDR_DECODE);
        m_valid = m_routine(&stream, &m_value) != 0;
    }
    XdrDecoded(const XdrDecoded&) = delete;
    XdrDecoded& operator=(const XdrDecoded&) = delete;
    ~XdrDecoded() {
        XDR stream{};
        stream.x_op = XDR_FREE;
        m_routine(&stream, &m_value);
    }

    /// False: the bytes are no such value.
    explicit operator bool() const { return m_valid; }
    const Value& operator*() const { return m_value; }
    const Value* operator->() const { return &m_value; }

private:
    static bool countFits(std::string_view bytes, std::size_t countAt) {
        return bytes.size() >= countAt + 4 && xdrWord(bytes, countAt) <= bytes.size() - countAt - 4;
    }

    XdrRoutine<Value> m_routine;
    Value m_value{};
    bool m_valid = false;
};

/// The value in XDR.
/// @param variableBytes an upper limit for the bytes of its strings and opaque fields.
template <class Value>
std::string toXdr(Value value, XdrRoutine<Value> routine, std::size_t variableBytes = 0) {
    constexpr std::size_t kFixedBytes = 128;  // more than any of the fixed parts in use here
    std::string bytes(kFixedBytes + variableBytes, '\0');
    XDR stream;
    xdrmem_create(&stream, bytes.data(), static_cast<u_int>(bytes.size()), XDR_ENCODE);
    const bool written = routine(&stream, &value) != 0;
    bytes.resize(written ? xdr_getpos(&stream) : 0);
    return bytes;
}

}  // namespace kdx
