#pragma once

#include <unistd.h>

namespace kdx::test {

/// While it lives, an administrator's test runs with an ordinary user's rights: permission bits count again.
class Unprivileged {
public:
    Unprivileged() {
        if (m_user != 0) return;
        m_dropped = setegid(kNobody) == 0 && seteuid(kNobody) == 0;
    }
    ~Unprivileged() {
        if (!m_dropped) return;
        [[maybe_unused]] const bool back = seteuid(m_user) == 0 && setegid(m_group) == 0;
    }
    Unprivileged(const Unprivileged&) = delete;
    Unprivileged& operator=(const Unprivileged&) = delete;

private:
    static constexpr uid_t kNobody = 65534;
    uid_t m_user = geteuid();
    gid_t m_group = getegid();
    bool m_dropped = false;
};

}  // namespace kdx::test
