#include "ui/automatics.h"

#include <algorithm>
#include <iterator>

namespace kdx {

QStringList Automatics::names() const {
    QStringList names;
    for (const Automatic* one : running()) names.append(one->m_name());
    return names;
}

void Automatics::stopAll() {
    for (const Automatic* one : running()) one->m_stop();
}

void Automatics::panic() {
    // What need not be ended on the air goes first: the end of an announcement stops the dynamic PS without its switch.
    for (const Automatic* one : running()) {
        if (!one->m_panic) one->m_stop();
    }
    for (const Automatic* one : std::vector(m_all)) {
        if (one->m_panic) one->m_panic();
    }
    stopAll();
}

std::vector<Automatic*> Automatics::running() const {
    std::vector<Automatic*> found;
    std::copy_if(m_all.begin(), m_all.end(), std::back_inserter(found),
                 [](const Automatic* one) { return one->runs(); });
    return found;
}

Automatic::Automatic(Automatics& all, std::function<QString()> name, std::function<void()> stop,
                     std::function<void()> panic)
    : m_in(all), m_name(std::move(name)), m_stop(std::move(stop)), m_panic(std::move(panic)) {
    m_in.m_all.push_back(this);
}

Automatic::~Automatic() {
    std::erase(m_in.m_all, this);
}

void Automatic::setRunning(bool running) {
    if (running == m_runs) return;
    m_runs = running;
    if (m_in.m_changed) m_in.m_changed();
}

}  // namespace kdx
