#pragma once

#include <atomic>
#include <chrono>
#include <filesystem>
#include <functional>
#include <string>

#include "base/clock.h"

namespace kdx {

class HMenue;
class TourDialogs;

/// A clock that goes on only while somebody sleeps, from noon on: pictures made by it are the same at every time.
class TourClock final : public Clock {
public:
    [[nodiscard]] double secondsSinceMidnight() const override;
    [[nodiscard]] Date today() const override;
    [[nodiscard]] std::chrono::steady_clock::time_point steadyNow() const override;
    void sleep(std::chrono::nanoseconds duration) override;

private:
    std::atomic<std::chrono::nanoseconds> m_passed{std::chrono::nanoseconds{0}};  // the instrument's thread sleeps too
};

/// Goes on where the tour has ended: uses menus, views and editors as a user does, and saves a picture of each, and of
/// each page as it is then, under the names that the manual has for them. An open session is needed.
/// @param scenario is opened and begun in its view.
/// @returns 0 when every picture was saved and no box showed.
[[nodiscard]] int makeViewsTour(HMenue& window, Clock& clock, TourDialogs& dialogs,
                                const std::filesystem::path& scenario, const std::filesystem::path& folder,
                                const std::function<void(const std::string& line)>& print);

}  // namespace kdx
