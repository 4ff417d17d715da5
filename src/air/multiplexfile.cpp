#include "air/multiplexfile.h"

#include <sndfile.h>

#include <algorithm>
#include <cmath>

namespace kdx::air {

namespace {

constexpr std::int64_t kLargestWav = 0xFFFF0000;  // with room for what stands around the samples
constexpr float kSteps = 32768;

}  // namespace

MultiplexFile::MultiplexFile(const std::string& file, int rate, SampleFormat format, Ticks longest)
    : m_rate(rate), m_format(format), m_multiplex(rate) {
    const bool isFloat = format == SampleFormat::Float;
    const auto bytes = samplesOf(longest) * static_cast<std::int64_t>(isFloat ? sizeof(float) : sizeof(std::int16_t));
    SF_INFO info{};
    info.samplerate = rate;
    info.channels = 1;
    info.format =
        (bytes > kLargestWav ? SF_FORMAT_RF64 : SF_FORMAT_WAV) | (isFloat ? SF_FORMAT_FLOAT : SF_FORMAT_PCM_16);
    m_file.reset(sf_open(file.c_str(), SFM_WRITE, &info), [](SNDFILE* opened) {
        if (opened != nullptr) sf_close(opened);
    });
    m_good = m_file != nullptr;
    if (!m_good) return;
    // One that ends earlier than it might is a WAV file after all.
    sf_command(m_file.get(), SFC_RF64_AUTO_DOWNGRADE, nullptr, SF_TRUE);
    // It would hold the time of day, and the same call is to give the same file.
    sf_command(m_file.get(), SFC_SET_ADD_PEAK_CHUNK, nullptr, SF_FALSE);
    m_good = sf_set_string(m_file.get(), SF_STR_COMMENT, "stereo multiplex; full scale 1.0 = 100 kHz deviation") == 0;
}

void MultiplexFile::add(const OnAir& sent, const sim::InstrumentSettings& settings) {
    write(m_multiplex.add(sent, settings));
}

void MultiplexFile::goOn(const OnAir& sent, const sim::InstrumentSettings& settings, Ticks length) {
    while (m_good && m_written < samplesOf(length)) {
        const auto samples = m_multiplex.add(sent, settings);
        const auto left = static_cast<std::size_t>(samplesOf(length) - m_written);
        write(samples.first(std::min(samples.size(), left)));
    }
}

void MultiplexFile::keepReadable() {
    if (m_good) sf_command(m_file.get(), SFC_UPDATE_HEADER_NOW, nullptr, 0);
}

bool MultiplexFile::close() {
    m_file.reset();
    return m_good;
}

void MultiplexFile::write(std::span<const float> samples) {
    if (!m_good) return;
    const auto count = static_cast<sf_count_t>(samples.size());
    if (m_format == SampleFormat::Float) {
        m_good = sf_write_float(m_file.get(), samples.data(), count) == count;
    } else {
        // Rounded here: the library would cut off, and so shift all by half a step.
        m_rounded.resize(samples.size());
        std::transform(samples.begin(), samples.end(), m_rounded.begin(), [](float sample) {
            return static_cast<std::int16_t>(std::clamp(std::lround(sample * kSteps), -32768L, 32767L));
        });
        m_good = sf_write_short(m_file.get(), m_rounded.data(), count) == count;
    }
    m_written += count;
}

std::int64_t MultiplexFile::samplesOf(Ticks time) const {
    return (time.count() * m_rate + Ticks::period::den / 2) / Ticks::period::den;
}

}  // namespace kdx::air
