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
    void feed(std::string_view bytes);
    /// The next complete record, or nothing yet.
    std::optional<std::string> next();
    /// A record has begun that is not complete yet.
    [[nodiscard]] bool hasBegun() const { return m_taken < m_unread.size() || !m_record.empty(); }
    /// A record too long has been announced, or one of its fragments is empty without being the last, of which there
    /// would be no end: the stream cannot be read on.
    [[nodiscard]] bool broken() const { return m_broken; }

private:
    std::size_t m_longest;
    std::string m_unread;
    std::size_t m_taken = 0;  // so many of its bytes are read by now
    std::string m_record;     // the fragments of it that have come so far
    bool m_broken = false;
};

/// The record as one fragment with its length in front.
std::string framed(std::string_view record);

}  // namespace kdx
