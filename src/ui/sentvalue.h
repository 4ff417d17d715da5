#pragma once

#include <optional>
#include <string>

#include "ui/pagecontext.h"
#include "ui/valuestate.h"

namespace kdx {

/// Whether what went out last has reached the instrument.
[[nodiscard]] bool linkWorks(const PageContext& with);

/// What the instrument has of one setting.
class SentValue {
public:
    /// @param key of the setting, for what the coder refuses.
    SentValue(const PageContext& with, const char* key) : m_with(with), m_key(key) {}

    /// The value is about to go out; whoever hears that it failed calls forget().
    void goesOut(const std::string& value);
    /// The value has gone out, as far as the link has told.
    void wentOut(const std::string& value);
    /// What went out has not arrived, or is meant for somebody else.
    void forget() { m_inForce.reset(); }
    [[nodiscard]] bool isInForce(const std::string& value) const { return m_inForce == value; }
    [[nodiscard]] bool isKnown() const { return m_inForce.has_value(); }
    /// What is to be said of a value. @param entry as it is shown, where that is more than what is sent.
    [[nodiscard]] Judgement judge(const std::string& value, const QString& entry) const;
    [[nodiscard]] Judgement judge(const std::string& value) const;

private:
    PageContext m_with;
    const char* m_key;
    std::optional<std::string> m_inForce;
};

}  // namespace kdx
