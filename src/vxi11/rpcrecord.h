#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>

namespace kdx {

/// Puts the records of an RPC byte stream together again: each comes in one or more fragments with a length in front.
class RecordReader {
public:
    /// @param longest records of more bytes than this are refused
    explicit RecordReader(std::size_t longest) : m_longest(longest) {}

    /// Takes bytes as they came from the stream, in pieces of any length.
    void feed(std::string_view bytes) { m_unread.append(bytes); }
    /// The next complete record, or nothing yet.
    std::optional<std::string> next();
    /// A record has been announced that is too long; the stream cannot be read on.
    [[nodiscard]] bool tooLong() const { return m_tooLong; }

private:
    std::size_t m_longest;
    std::string m_unread;
    std::string m_record;  // the fragments of it that have come so far
    bool m_tooLong = false;
};

/// The record as one fragment with its length in front.
std::string framed(std::string_view record);

}  // namespace kdx
