#pragma once

#include <sys/resource.h>
#include <csignal>

namespace kdx::test {

/// While it lives no file of this process can grow, as on a full disk; where there is room left, beyond so many bytes.
class FullDisk {
public:
    explicit FullDisk(rlim_t room = 0) {
        getrlimit(RLIMIT_FSIZE, &m_before);
        const rlimit limit{room, m_before.rlim_max};
        setrlimit(RLIMIT_FSIZE, &limit);
    }
    ~FullDisk() {
        setrlimit(RLIMIT_FSIZE, &m_before);
        std::signal(SIGXFSZ, m_handler);
    }
    FullDisk(const FullDisk&) = delete;
    FullDisk& operator=(const FullDisk&) = delete;

private:
    void (*m_handler)(int) = std::signal(SIGXFSZ, SIG_IGN);  // else the system ends the process
    rlimit m_before{};
};

}  // namespace kdx::test
