#include "link/commandlog.h"

#include <string>

#include "settings/datafolder.h"
#include "settings/durablefile.h"

namespace kdx {

void CommandLog::empty() {
    if (!m_data.isReadOnly()) note(emptyPlainFile(m_data.file(kCommandLog)));
}

void CommandLog::append(std::string_view line) {
    if (!m_data.isReadOnly()) note(appendToPlainFile(m_data.file(kCommandLog), std::string(line) + "\r\n"));
}

void CommandLog::retry() {
    if (!m_writable) note(appendToPlainFile(m_data.file(kCommandLog), ""));
}

void CommandLog::note(bool written) {
    if (std::exchange(m_writable, written) != written && m_changed) m_changed();
}

}  // namespace kdx
