#pragma once

#include <vector>

#include "telephony/simulation/Drive.h"
#include "telephony/simulation/GSMUMTS/Network.h"

namespace kelvo::simulation::gsm {

/// What the phone's receiver has of both layers' cells. Readings are filtered over about a second, as the modem filters
/// them, so that the fading is mostly gone; each stands until the next measurement.
class Air {
public:
    /// A cell at this Ec/No is not found: the reading goes no lower.
    static constexpr double kEcNoFloor = -20;   ///< dB
    static constexpr double kPilotShare = -10;  ///< dB: pilot channel of a UMTS cell's full power
    static constexpr double kLoad = 0.5;        ///< of full power, on average

    Air(const Network& network, const Journey& journey, Random random);

    /// Drives on to then and measures.
    void measure(Time time);

    /// dBm: RXLEV's quantity.
    double gsmLevel(std::size_t sector) const { return _gsmLevels[sector]; }
    /// GSM sectors, the strongest first; of those on one carrier only the strongest.
    const std::vector<std::size_t>& gsmByLevel() const { return _gsmByLevel; }

    double umtsRssi() const { return _umtsRssi; }                                ///< dBm: the whole carrier
    double ecNo(std::size_t sector) const { return _ecNo[sector]; }              ///< dB: pilot to RSSI
    double rscp(std::size_t sector) const { return _umtsRssi + _ecNo[sector]; }  ///< dBm: pilot
    bool isFound(std::size_t sector) const { return _ecNo[sector] > kEcNoFloor; }
    /// UMTS sectors, the best first.
    const std::vector<std::size_t>& umtsByEcNo() const { return _umtsByEcNo; }
    /// dB: of the shared data channel, which has 40 % of the power and is nearly orthogonal to its own cell's others.
    double dataSinr(std::size_t sector) const;

    const Drive& gsm() const { return _gsm; }
    const Drive& umts() const { return _umts; }

private:
    void measureGsm();
    void measureUmts();

    const Network& _network;
    Drive _gsm;
    Drive _umts;
    Random _random;
    std::vector<double> _gsmLevels;
    std::vector<double> _ecNo;
    std::vector<std::size_t> _gsmByLevel;
    std::vector<std::size_t> _umtsByEcNo;
    double _umtsRssi = 0;
    bool _isFirst = true;
};

}  // namespace kelvo::simulation::gsm
