#pragma once

#include <coroutine>
#include <exception>
#include <utility>

#include "scenario/pauses.h"

namespace kdx::scenario {

/// A function that is a part of such work: it may await pauses and other parts. It begins when it is awaited.
template <typename Result>
class [[nodiscard]] Part {
public:
    struct Promise {
        Pauses* pauses = nullptr;
        std::coroutine_handle<> awaiting;
        Result result{};
        std::exception_ptr failure;

        struct Ended {
            [[nodiscard]] bool await_ready() const noexcept { return false; }
            void await_suspend(std::coroutine_handle<Promise> part) const noexcept {
                part.promise().pauses->setNext(part.promise().awaiting);
            }
            void await_resume() const noexcept {}
        };
        Part get_return_object() { return Part(std::coroutine_handle<Promise>::from_promise(*this)); }
        [[nodiscard]] std::suspend_always initial_suspend() const noexcept { return {}; }
        [[nodiscard]] Ended final_suspend() const noexcept { return {}; }
        void return_value(Result value) { result = std::move(value); }
        void unhandled_exception() { failure = std::current_exception(); }
    };

    using promise_type = Promise;  // by which the compiler finds it

    Part(Part&& other) noexcept : m_part(std::exchange(other.m_part, nullptr)) {}
    Part& operator=(Part&& other) noexcept {
        std::swap(m_part, other.m_part);
        return *this;
    }
    Part(const Part&) = delete;
    Part& operator=(const Part&) = delete;
    ~Part() {
        if (m_part) m_part.destroy();
    }

    /// Makes it the work.
    void beginIn(Pauses& pauses, std::coroutine_handle<> awaiting = nullptr) {
        m_part.promise().pauses = &pauses;
        m_part.promise().awaiting = awaiting;
        pauses.setNext(m_part);
    }
    /// What came of it; throws what ended it.
    Result result() {
        if (m_part.promise().failure) std::rethrow_exception(m_part.promise().failure);
        return std::move(m_part.promise().result);
    }

    [[nodiscard]] bool await_ready() const noexcept { return false; }
    template <typename Awaiting>
    void await_suspend(std::coroutine_handle<Awaiting> awaiting) {
        beginIn(*awaiting.promise().pauses, awaiting);
    }
    Result await_resume() { return result(); }

private:
    explicit Part(std::coroutine_handle<Promise> part) : m_part(part) {}

    std::coroutine_handle<Promise> m_part;
};

}  // namespace kdx::scenario
