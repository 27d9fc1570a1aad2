#pragma once

#include <array>
#include <optional>
#include <vector>

#include "telephony/simulation/Drive.h"
#include "telephony/simulation/HeldFor.h"
#include "telephony/simulation/UTRAN/UtranNetwork.h"

namespace kelvo::simulation {

/// The states of the radio resource control (3GPP TS 25.331, section 7.1).
enum class UtranMode { Disconnected, Connecting, CellFach, CellDch, CellPch, UraPch };

/// A cell as the phone knows it: the serving one or another.
struct UtranMeasurement {
    enum class Set { Active, Monitored, Detected };  ///< TS 25.331, section 8.4.0: serving, listed, found unlisted
    std::size_t cell = 0;
    double rscp = 0;  ///< dBm, of the P-CCPCH, filtered as in TS 25.331, section 8.6.7.2
    Set set = Set::Detected;
    bool isJointlyDetected = false;  ///< its codes are cancelled together with the serving cell's
};

struct UtranGsmMeasurement {
    std::size_t cell = 0;  ///< whose mast carries the GSM cell
    int rssi = 0;          ///< dBm
    bool isIdentified = false;
};

/// A transport channel of a dedicated connection.
struct UtranTransportChannel {
    int id = 0;
    double blockErrors = 0;  ///< share of its blocks
};

/// The physical channels that carry them: a coded composite transport channel.
struct UtranComposite {
    int id = 0;
    int timeslots = 0;                              ///< in use
    std::array<std::optional<double>, 6> sir = {};  ///< dB, in the traffic timeslots 1 to 6; none where not in use
};

/// The modem: camps, measures, reselects and hands over, registers, and goes through the states of a connection.
class UtranModem {
public:
    explicit UtranModem(std::uint64_t seed);

    /// Moves on to then, one step after the last time.
    void moveTo(Time now);

    // What the last step has brought.
    bool hasMeasured() const { return _hasMeasured; }
    bool hasChangedCell() const { return _hasChangedCell; }
    bool hasChangedMode() const { return _hasChangedMode; }
    bool hasRegistered() const { return _hasRegistered; }
    bool hasChangedContexts() const { return _hasChangedContexts; }

    const Drive& drive() const { return _drive; }
    const std::vector<UtranCell>& cells() const { return _cells; }
    std::size_t servingIndex() const { return _serving; }
    const UtranCell& serving() const { return _cells[_serving]; }
    UtranMode mode() const { return _mode; }
    /// The location area that the network believes the phone to be in; in another it may only call for help.
    int registeredArea() const { return _registeredArea; }
    bool isRegistered() const { return _registeredArea == serving().locationArea; }

    /// The serving cell and then the others that were measured last, the strongest first.
    const std::vector<UtranMeasurement>& measurements() const { return _measurements; }
    const std::vector<UtranGsmMeasurement>& gsmMeasurements() const { return _gsmMeasurements; }
    /// Of a dedicated connection; empty without one.
    const std::vector<UtranTransportChannel>& transportChannels() const { return _transportChannels; }
    const std::vector<UtranComposite>& composites() const { return _composites; }
    /// The access points of the packet contexts that are active.
    const std::vector<const char*>& contexts() const { return _contexts; }

private:
    enum class Session { Registration, Speech, Data };

    void followConnection();
    void enter(UtranMode mode, double seconds);
    void begin(Session session);
    void disconnect();
    void registerInArea();
    void finishRegistration();
    void measure();
    void readCells();
    double interference(std::size_t cell) const;
    void changeCell();
    void camp(std::size_t cell);
    void listCells();
    void listGsmCells();
    UtranMeasurement::Set setOf(std::size_t cell) const;
    bool isCancelled(std::size_t cell) const;
    void readChannels();
    double availableSir() const;
    bool isDedicated() const { return _mode == UtranMode::CellDch; }
    bool canSignal() const { return isDedicated() || _mode == UtranMode::CellFach; }
    double level(std::size_t cell) const;

    Random _random;
    std::vector<Sector> _sectors;
    std::vector<UtranCell> _cells;
    Drive _drive;

    Time _now{0};
    std::size_t _serving = 0;
    std::vector<std::optional<double>> _filtered;  // dBm; none of a cell that is not found
    HeldFor _better;
    Time _camped{0};
    UtranMode _mode = UtranMode::Disconnected;
    Time _until{0};  // the mode lasts
    Session _session = Session::Data;
    int _registeredArea = 0;
    std::optional<Time> _registersAt;

    std::vector<UtranMeasurement> _measurements;
    std::vector<UtranGsmMeasurement> _gsmMeasurements;
    std::vector<UtranTransportChannel> _transportChannels;
    std::vector<UtranComposite> _composites;
    std::vector<const char*> _contexts{"internet"};
    bool _hasMeasured = false;
    bool _hasChangedCell = false;
    bool _hasChangedMode = false;
    bool _hasRegistered = false;
    bool _hasChangedContexts = false;
};

}  // namespace kelvo::simulation
