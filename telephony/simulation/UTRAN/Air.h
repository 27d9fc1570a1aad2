#pragma once

#include <optional>
#include <vector>

#include "telephony/simulation/Drive.h"
#include "telephony/simulation/UTRAN/Network.h"

namespace kelvo::simulation::utran {

/// What the phone's receiver has of the cells: which it finds, and how strong their P-CCPCHs are.
class Air {
public:
    static constexpr double kReadingDeviation = 1.5;  ///< dB: what is left of the fading in one reading

    /// `network` must outlive it.
    Air(const Network& network, const Journey& journey, Random random);

    /// Drives on to then.
    void moveTo(Time now) { _drive.moveTo(now); }
    const Drive& drive() const { return _drive; }

    /// Looks once at every cell. The serving cell is always found.
    void measure(std::size_t serving);

    bool isFound(std::size_t cell) const { return _filtered[cell].has_value(); }
    /// RSCP in dBm, filtered as in 3GPP TS 25.331, section 8.6.7.2; only of a cell that is found.
    double level(std::size_t cell) const { return *_filtered[cell]; }
    /// Strong enough beside the serving cell that its codes are cancelled together with that cell's.
    bool isJointlyDetected(std::size_t cell, std::size_t serving) const;
    /// The SIR in dB that the base station can give a dedicated channel at most, against all else on the carrier.
    double availableSir(std::size_t serving) const;

private:
    double interference(std::size_t cell) const;

    const std::vector<Cell>& _cells;
    Drive _drive;
    Random _random;
    std::vector<std::optional<double>> _filtered;  // none of a cell that is not found
};

}  // namespace kelvo::simulation::utran
