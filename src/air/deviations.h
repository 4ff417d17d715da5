#pragma once

namespace kdx::sim {
struct Setup;
}

namespace kdx::air {

// How deep the tones of ARI modulate its carrier.
inline constexpr double kAreaDepth = 0.6;
inline constexpr double kAnnouncementDepth = 0.3;

/// What each part of the multiplex may peak at, in hertz; 0 for what is off.
struct Deviations {
    double total = 0;  ///< what all of it together may peak at
    double audio = 0;  ///< what the others leave of that
    double pilot = 0;
    double rds = 0;
    double ariCarrier = 0;
    double ari = 0;  ///< the carrier with its tones

    /// What is asked for besides audio; more than the total when that is set too low.
    [[nodiscard]] double subcarriers() const { return pilot + rds + ari; }
    [[nodiscard]] double peak() const { return audio + subcarriers(); }
};

[[nodiscard]] Deviations deviationsOf(const sim::Setup& setup);

}  // namespace kdx::air
