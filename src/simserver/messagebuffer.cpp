#include "simserver/messagebuffer.h"

#include <utility>

namespace kdx::simserver {

MessageBuffer::Taken MessageBuffer::take(std::string_view bytes, bool end) {
    Taken taken;
    const auto finish = [&] {
        if (!m_message.empty()) taken.messages.push_back(std::exchange(m_message, {}));
        clear();
    };
    for (const char c : bytes) {
        const bool isText = m_quotes.take(c);
        if (!m_dropping && m_message.size() == kLongest) {
            m_message.clear();
            m_dropping = true;
            taken.overrun = true;
        }
        if (!m_dropping) m_message += c;
        if (c == '\n' && !isText && !m_dropping) finish();
    }
    if (end) finish();
    return taken;
}

}  // namespace kdx::simserver
