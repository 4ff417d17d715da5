#pragma once

#include <chrono>
#include <coroutine>
#include <optional>
#include <utility>

namespace kdx::scenario {

/// Work that pauses. It is taken from one pause to the next: who does so sleeps meanwhile, or has other things to do.
class Pauses {
public:
    using Length = std::chrono::nanoseconds;

    /// To be awaited: the work goes on so much later.
    struct Pause {
        Pauses& pauses;
        Length length;
        [[nodiscard]] bool await_ready() const noexcept { return false; }
        void await_suspend(std::coroutine_handle<> rest) const noexcept {
            pauses.m_next = rest;
            pauses.m_pause = length;
        }
        void await_resume() const noexcept {}
    };
    [[nodiscard]] Pause pause(Length length) { return {*this, length}; }

    /// Takes the work to its next pause. @returns how long that is to last; nothing at the end.
    std::optional<Length> goOn() {
        m_pause.reset();
        while (m_next && !m_pause) std::exchange(m_next, nullptr).resume();
        return m_pause;
    }

    /// What is done next. Nothing is begun from within something else: however often parts follow each other without a
    /// pause, they take no stack.
    void setNext(std::coroutine_handle<> next) noexcept { m_next = next; }

private:
    std::coroutine_handle<> m_next;
    std::optional<Length> m_pause;
};

}  // namespace kdx::scenario
