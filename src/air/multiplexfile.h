#pragma once

#include <cstdint>
#include <memory>
#include <span>
#include <string>
#include <vector>

#include "air/multiplex.h"

struct sf_private_tag;

namespace kdx::air {

enum class SampleFormat { Float, SixteenBit };

/// A multiplex in a WAV file, cut at its end.
class MultiplexFile {
public:
    /// @param rate one of the multiplex's. @param longest no more will be written; only where the sizes in a WAV file
    /// cannot hold that does it become an RF64 file.
    MultiplexFile(const std::string& file, int rate, SampleFormat format, Ticks longest);

    /// Sends something for the length of a group.
    void add(const OnAir& sent, const sim::InstrumentSettings& settings);
    /// Goes on with that until the time is over that is asked for, which was not before now.
    void goOn(const OnAir& sent, const sim::InstrumentSettings& settings, Ticks length);
    /// From here on the file can be read as far as it is written, also when the program is killed.
    void keepReadable();
    /// False once something could not be written.
    [[nodiscard]] bool good() const { return m_good; }
    [[nodiscard]] std::int64_t samples() const { return m_written; }
    /// Whether all could be written.
    [[nodiscard]] bool close();

private:
    void write(std::span<const float> samples);
    [[nodiscard]] std::int64_t samplesOf(Ticks time) const;

    int m_rate;
    SampleFormat m_format;
    std::shared_ptr<sf_private_tag> m_file;
    Multiplex m_multiplex;
    std::vector<std::int16_t> m_rounded;
    std::int64_t m_written = 0;
    bool m_good = true;
};

}  // namespace kdx::air
