#pragma once

#include <functional>
#include <set>
#include <string>
#include <utility>

namespace kdx::air {

/// Hears of what cannot be sent as it was given, in words (UTF-8).
using Warn = std::function<void(const std::string& text)>;

/// Tells each thing once, however often settings are looked through.
class Warnings {
public:
    explicit Warnings(Warn warn) : m_warn(std::move(warn)) {}
    void add(const std::string& text) {
        if (m_told.insert(text).second && m_warn) m_warn(text);
    }

private:
    Warn m_warn;
    std::set<std::string> m_told;
};

}  // namespace kdx::air
