#pragma once

#include "telephony/simulation/Random.h"

namespace kelvo::simulation {

/// Loss of the path to a base station in a town, in dB: the macro-cell model for urban areas of 3GPP TR 36.942,
/// section 4.5.2, with antennas 15 m above the roofs. Nearer than 35 m the loss is that of 35 m.
double pathLoss(double metres, double carrierMHz);

/// Gain of a sector antenna off its direction, in dB, 0 straight ahead: the horizontal pattern of 3GPP TR 36.942,
/// section 4.2.1.1 (65 degrees wide, 20 dB front to back). `degrees` may be any angle.
double sectorGain(double degrees);

/// Shadows of houses: log-normal, correlated over the way driven as measured by Gudmundson ("Correlation model for
/// shadow fading in mobile radio systems", 1991).
class Shadowing {
public:
    static constexpr double kDeviation = 6;  ///< dB
    static constexpr double kReach = 60;     ///< metres after which the correlation is 1/e

    explicit Shadowing(Random random) : _random(std::move(random)), _now(kDeviation * _random.normal()) {}

    /// In dB, after `driven` metres in all; never less than the time before.
    double after(double driven);

private:
    Random _random;
    double _driven = 0;
    double _now;
};

/// Rayleigh fading: the sum of many echoes, drawn anew for each reading, as readings lie farther apart than the
/// fading is correlated. In dB about the local mean, at most 30 below it.
double rayleighFading(Random& random);

double toMilliwatts(double dBm);
double toDecibels(double ratio);

/// What a link carries at this SINR (signal to interference and noise) in dB: 0.6 of what Shannon allows (3GPP
/// TR 36.942, annex A.1), per second in bits for a bandwidth in Hz.
double linkCapacity(double bandwidth, double sinr);
/// The SINR in dB that a link needs to carry that much.
double neededSinr(double bandwidth, double capacity);

}  // namespace kelvo::simulation
