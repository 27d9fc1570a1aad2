#pragma once

#include <optional>
#include <vector>

#include "telephony/simulation/Drive.h"
#include "telephony/simulation/LTE/LteNetwork.h"

namespace kelvo::simulation {

/// One reading of a cell, fading included, within the ranges that a phone reports (3GPP TS 36.133, sections 9.1.4 and
/// 9.1.7); quantities as in TS 36.214.
struct LteReading {
    double rsrp = 0;         ///< dBm
    double rsrq = 0;         ///< dB
    double rssi = 0;         ///< dBm, of the whole carrier
    double averageRsrp = 0;  ///< dBm, filtered as in TS 36.331, section 5.5.3.2
    double averageRsrq = 0;  ///< dB
};

/// The phone's receiver: which cells it finds on a carrier, and what it reads of them.
class LteReceiver {
public:
    /// `cells` must outlive the receiver.
    LteReceiver(const std::vector<LteCell>& cells, Random random)
        : _cells(cells), _tracked(cells.size()), _random(std::move(random)) {}

    /// Looks once at every cell of a carrier. The serving cell is always found.
    void measure(const Drive& drive, const LteCarrier& carrier, std::size_t serving, Time now);
    /// The carrier is not looked at any longer: its cells must be found anew, but for the serving one.
    void leave(const LteCarrier& carrier, std::size_t serving);

    /// The last reading of a cell; only of one that has been found.
    const LteReading& reading(std::size_t cell) const { return _tracked[cell].reading; }
    /// Found long enough ago to be identified and measured.
    bool isMeasured(std::size_t cell, Time now) const;
    /// Found, but not measured yet.
    bool isDetected(std::size_t cell, Time now) const;

private:
    struct Tracked {
        std::optional<Time> found;
        LteReading reading;
    };

    bool isOn(std::size_t cell, const LteCarrier& carrier) const {
        return _cells[cell].carrier.downlink == carrier.downlink;
    }
    double sum(const LteCarrier& carrier, const std::vector<double>& power) const;
    void find(std::size_t cell, double ratio, bool isServing, Time now);
    void read(Tracked& cell, double power, double all, int resourceBlocks);
    double fading();

    const std::vector<LteCell>& _cells;
    std::vector<Tracked> _tracked;
    Random _random;
};

}  // namespace kelvo::simulation
