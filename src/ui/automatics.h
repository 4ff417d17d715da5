#pragma once

#include <QString>
#include <QStringList>

#include <functional>
#include <vector>

namespace kdx {

class Automatic;

/// Property of a button that only takes note that something is to end: it can be used while commands go out.
inline constexpr const char* kWorksWhileSending = "worksWhileSending";

/// All that sends by itself until somebody stops it. The list of the window.
class Automatics {
public:
    /// Who hears that one begins or ends.
    void onChange(std::function<void()> changed) { m_changed = std::move(changed); }
    [[nodiscard]] bool anyRuns() const { return !running().empty(); }
    /// Those that run, by name.
    [[nodiscard]] QStringList names() const;
    /// Stops all that run; nothing is sent.
    void stopAll();
    /// Stops all, and ends on the air what must not stay there.
    void panic();

private:
    friend class Automatic;
    [[nodiscard]] std::vector<Automatic*> running() const;

    std::vector<Automatic*> m_all;
    std::function<void()> m_changed;
};

/// One of them; lives as long as the control that switches it.
class Automatic {
public:
    /// @param name for the user, in the current language. @param stop switches the control off without sending.
    /// @param panic is done first at a panic, whether this runs or not, and may send.
    Automatic(Automatics& all, std::function<QString()> name, std::function<void()> stop,
              std::function<void()> panic = nullptr);
    ~Automatic();
    Automatic(const Automatic&) = delete;
    Automatic& operator=(const Automatic&) = delete;

    void setRunning(bool running);
    [[nodiscard]] bool runs() const { return m_runs; }

private:
    friend class Automatics;
    Automatics& m_in;
    std::function<QString()> m_name;
    std::function<void()> m_stop, m_panic;
    bool m_runs = false;
};

}  // namespace kdx
