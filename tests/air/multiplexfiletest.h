#pragma once

#include <cstring>
#include <string>
#include <vector>

#include "air/multiplexfile.h"
#include "air/multiplextest.h"
#include "settings/profilefile.h"
#include "support/tempfolder.h"

namespace kdx::air {

using namespace std::chrono_literals;

/// Groups of two seconds alone on the air, also in a file that goes on to three seconds.
class MultiplexFiles : public MultiplexTest {
protected:
    MultiplexFiles() { data(); }

    [[nodiscard]] std::string path() const { return (folder.path() / "multiplex.wav").string(); }

    void write(SampleFormat format, Ticks longest = 3s) {
        MultiplexFile file(path(), rate, format, longest);
        const auto send = [this, &file](const OnAir& sent) {
            file.add(sent, broadcast.transmission().settings);
            const auto more = multiplex.add(sent, broadcast.transmission().settings);
            samples.insert(samples.end(), more.begin(), more.end());
        };
        while (broadcast.time() < noon() + 2s) send(broadcast.next());
        for (int times = 0; times < 12; ++times) {
            const auto more = multiplex.add({}, broadcast.transmission().settings);
            samples.insert(samples.end(), more.begin(), more.end());
        }
        file.goOn({}, broadcast.transmission().settings, 3s);
        EXPECT_EQ(file.samples(), 3 * rate);
        EXPECT_TRUE(file.close());
        samples.resize(3 * static_cast<std::size_t>(rate));
    }
    /// What stands in a chunk and behind it.
    [[nodiscard]] std::string chunk(const std::string& name) const {
        const std::string bytes = readFile(path()).value_or("");
        const std::size_t at = bytes.find(name);
        return at == std::string::npos ? "" : bytes.substr(at + 8);
    }
    template <typename Number>
    [[nodiscard]] std::vector<Number> numbers() const {
        const std::string bytes = chunk("data");
        std::vector<Number> read(bytes.size() / sizeof(Number));
        std::memcpy(read.data(), bytes.data(), read.size() * sizeof(Number));
        return read;
    }

    test::TempFolder folder;
};

}  // namespace kdx::air
