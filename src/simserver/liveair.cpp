#include "simserver/liveair.h"

#include <filesystem>
#include <stdexcept>
#include <string_view>
#include <utility>

#include "base/clock.h"
#include "sim/virtualinstrument.h"

namespace kdx::simserver {

namespace {

using std::chrono::steady_clock;

constexpr std::string_view kStream = "-";
// What comes later than this, as after a machine's sleep, is not made up for.
constexpr std::chrono::seconds kLongestDelay{1};
// A clock that was set, or runs at another pace, differs by more from the time that the groups have come to: the clock
// group is to come within 0.1 s of its minute.
constexpr std::chrono::milliseconds kMostDifference{30};
constexpr int kGroupsOfASecond = 11;
constexpr std::chrono::hours kNoEnd{24 * 365};
constexpr std::size_t kMostWaitingSamples = std::size_t{4} * 1024 * 1024;  // bytes; some four seconds

/// @throws std::runtime_error for what is there and is no plain file: writing to it might hold up everything else.
bool isFile(const std::string& place) {
    if (place.empty() || place == kStream) return false;
    std::error_code error;
    if (std::filesystem::exists(place, error) && !std::filesystem::is_regular_file(place, error))
        throw std::runtime_error(place + " is no plain file");
    return true;
}

}  // namespace

LiveAir::LiveAir(PollLoop& loop, const sim::VirtualInstrument& instrument, const Clock& clock, const Places& places,
                 int stream, Tell tell)
    : m_loop(loop),
      m_instrument(instrument),
      m_clock(clock),
      m_places(places),
      m_tell(std::move(tell)),
      m_composer(m_tell),
      m_time(air::airTimeOf(clock)),
      m_begin(steady_clock::now()) {
    if (m_places.groups == kStream) m_stream = std::make_unique<LineWriter>(stream);
    if (m_places.multiplex == kStream) {
        m_stream = std::make_unique<LineWriter>(stream, kMostWaitingSamples);
        m_multiplex.emplace(air::kMultiplexRate);
    }
    if (isFile(m_places.groups)) {
        m_groupFile.open(m_places.groups, std::ios::binary);
        if (!m_groupFile) throw std::runtime_error(m_places.groups + " cannot be written");
    }
    if (isFile(m_places.multiplex)) {
        m_multiplexFile.emplace(m_places.multiplex, air::kMultiplexRate, air::SampleFormat::Float, kNoEnd);
        if (!m_multiplexFile->good()) throw std::runtime_error(m_places.multiplex + " cannot be written");
    }
    settingsChanged();
    callAtEndOfGroup();
}

LiveAir::~LiveAir() {
    if (m_timer) m_loop.cancel(*m_timer);
    if (m_multiplexFile && !m_multiplexFile->close() && !m_places.multiplex.empty()) lost(m_places.multiplex);
}

void LiveAir::settingsChanged() {
    m_composer.take(m_instrument.transmission());
}

PollLoop::TimePoint LiveAir::endOf(std::int64_t groups) const {
    return m_begin + std::chrono::duration_cast<steady_clock::duration>(air::kGroupTime * groups);
}

void LiveAir::callAtEndOfGroup() {
    m_timer = m_loop.callAt(endOf(m_groups + 1), [this] { endGroup(); });
}

void LiveAir::endGroup() {
    const auto now = steady_clock::now();
    if (now - endOf(m_groups + 1) > kLongestDelay) {
        m_begin = now - std::chrono::duration_cast<steady_clock::duration>(air::kGroupTime);
        m_groups = 0;
    }
    while (endOf(m_groups + 1) <= now) {
        sendGroup();
        ++m_groups;
    }
    callAtEndOfGroup();
}

void LiveAir::sendGroup() {
    // What the clock showed when the group began, wherever this one is late.
    const auto since = steady_clock::now() - endOf(m_groups);
    const air::AirTime began = air::airTimeOf(m_clock) - std::chrono::round<air::Ticks>(since);
    if (std::chrono::abs(began - m_time) > kMostDifference) m_time = began;
    const air::OnAir sent = m_composer.next(m_time);
    m_time += air::kGroupTime;
    if (sent.kind == air::OnAir::Kind::Group && !m_places.groups.empty()) writeLine(air::logLine(sent.group, m_time));
    if (!m_places.multiplex.empty()) writeSamples(sent);
}

void LiveAir::writeLine(const std::string& line) {
    if (m_places.groups == kStream) {
        pass(line + "\n", m_places.groups, "the groups are");
    } else if (!(m_groupFile << line << std::endl)) {
        lost(m_places.groups);
    }
}

void LiveAir::writeSamples(const air::OnAir& sent) {
    const sim::InstrumentSettings& settings = m_instrument.transmission().settings;
    if (m_multiplexFile) {
        m_multiplexFile->add(sent, settings);
        if (m_groups % kGroupsOfASecond == 0) m_multiplexFile->keepReadable();
        if (!m_multiplexFile->good()) lost(m_places.multiplex);
        return;
    }
    const auto bytes = std::as_bytes(m_multiplex->add(sent, settings));
    pass({reinterpret_cast<const char*>(bytes.data()), bytes.size()}, m_places.multiplex, "the multiplex is");
}

void LiveAir::pass(std::string_view bytes, std::string& place, const char* what) {
    const bool hasRoom = m_stream->pass(bytes);
    if (m_stream->isLost()) {
        lost(place);
    } else if (!hasRoom && std::exchange(m_tellsOfGaps, false)) {
        m_tell(std::string(what) + " not read as fast as sent: there are gaps");
    }
}

/// Tells it once; nothing goes there any more.
void LiveAir::lost(std::string& place) {
    m_tell((place == kStream ? "the standard output" : place) + " cannot be written any more");
    place.clear();
}

}  // namespace kdx::simserver
