#pragma once

#include <functional>
#include <set>
#include <string>
#include <utility>

namespace kdx::air {

/// Hears of what cannot be sent as it was given, in words (UTF-8).
using Warn = std::function<void(const std::string& text)>;

/// Tells each thing once, however often settings are looked through, and a thousand things at most.
class Warnings {
public:
    explicit Warnings(Warn warn) : m_warn(std::move(warn)) {}
    void add(const std::string& text) {
        constexpr std::size_t kMost = 1000;  // whoever sends on and on what cannot go out is not heard for ever
        if (m_told.size() > kMost || !m_told.insert(text).second || !m_warn) return;
        m_warn(m_told.size() > kMost ? "further warnings are left out" : text);
    }

private:
    Warn m_warn;
    std::set<std::string> m_told;
};

}  // namespace kdx::air
