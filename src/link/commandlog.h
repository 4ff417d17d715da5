#pragma once

#include <functional>
#include <string_view>
#include <utility>

namespace kdx {

class DataFolder;

/// The command log of the data folder. It is opened and closed for every line, so that it can be read or deleted while
/// the program runs. Only a plain file is written: what stands behind a link or a pipe in its place is not the
/// program's to empty, and nobody may be reading the pipe. Nothing throws; a failure stops no command.
class CommandLog {
public:
    explicit CommandLog(const DataFolder& data) : m_data(data) {}

    /// Empties the log; creates it when missing.
    void empty();
    /// Adds a line; creates the log when missing.
    void append(std::string_view line);
    /// Looks again whether a log that could not be written can be now.
    void retry();

    /// Whether the log could be written when that was last tried.
    [[nodiscard]] bool isWritable() const { return m_writable; }
    /// Called whenever isWritable() changes.
    void onChange(std::function<void()> callback) { m_changed = std::move(callback); }

private:
    void note(bool written);

    const DataFolder& m_data;
    std::function<void()> m_changed;
    bool m_writable = true;
};

}  // namespace kdx
