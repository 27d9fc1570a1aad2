#pragma once

#include <optional>
#include <vector>

#include "telephony/simulation/Drive.h"
#include "telephony/simulation/LTE/Network.h"

namespace kelvo::simulation::lte {

/// One reading of a cell, fading included, within the ranges that a phone reports (3GPP TS 36.133, sections 9.1.4 and
/// 9.1.7); quantities as in TS 36.214.
struct Reading {
    double rsrp = 0;          ///< dBm
    double rsrq = 0;          ///< dB
    double rssi = 0;          ///< dBm, of the whole carrier
    double filteredRsrp = 0;  ///< dBm, filtered as in TS 36.331, section 5.5.3.2
    double filteredRsrq = 0;  ///< dB
};

/// What the phone's receiver has of the cells: which it finds on a carrier, and what it reads of them.
class Air {
public:
    /// `network` must outlive it.
    Air(const Network& network, const Journey& journey, Random random)
        : _cells(network.cells),
          _drive(network.sectors, journey, random.split()),
          _tracked(_cells.size()),
          _random(std::move(random)) {}

    /// Drives on to then.
    void moveTo(Time now) { _drive.moveTo(now); }
    const Drive& drive() const { return _drive; }

    /// Looks once at every cell of a carrier. The serving cell is always found.
    void measure(Time now, const Carrier& carrier, std::size_t serving);
    /// The carrier is not looked at any longer: its cells must be found anew, but for the serving one.
    void leave(const Carrier& carrier, std::size_t serving);

    /// The last reading of a cell; only of one that has been found.
    const Reading& reading(std::size_t cell) const { return _tracked[cell].reading; }
    /// Found long enough ago to be identified and measured.
    bool isMeasured(Time now, std::size_t cell) const;
    /// Found, but not measured yet.
    bool isDetected(Time now, std::size_t cell) const;

private:
    struct Tracked {
        std::optional<Time> found;
        Reading reading;
    };

    bool isOn(std::size_t cell, const Carrier& carrier) const {
        return _cells[cell].carrier.downlink == carrier.downlink;
    }
    double sum(const Carrier& carrier, const std::vector<double>& power) const;
    void find(Time now, std::size_t cell, double sinr, bool isServing);
    void read(Tracked& cell, double power, double all, int resourceBlocks);
    double fading();

    const std::vector<Cell>& _cells;
    Drive _drive;
    std::vector<Tracked> _tracked;
    Random _random;
};

}  // namespace kelvo::simulation::lte
