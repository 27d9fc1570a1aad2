#pragma once

#include <array>
#include <optional>
#include <vector>

#include "telephony/simulation/HeldFor.h"
#include "telephony/simulation/PhoneUser.h"
#include "telephony/simulation/UTRAN/Air.h"
#include "telephony/simulation/UTRAN/Reports.h"

namespace kelvo::simulation::utran {

/// The modem: camps, measures, reselects and hands over, registers, and goes through the states of a connection.
class Modem {
public:
    /// Both must outlive it.
    Modem(const Network& network, Air& air, Random random);

    /// Moves on to then, one step after the last time.
    void step(Time now, const PhoneUser& user);

    /// In the last step.
    bool hasMeasured() const { return _hasMeasured; }

    const std::vector<Cell>& cells() const { return _network.cells; }
    std::size_t servingIndex() const { return _serving; }
    const Cell& serving() const { return _network.cells[_serving]; }
    RrcState rrcState() const { return _rrcState; }
    /// The location area that the network believes the phone to be in; in another it may only call for help.
    int registeredArea() const { return _registeredArea; }
    bool isRegistered() const { return _registeredArea == serving().locationArea; }

    /// The serving cell and then the others that were measured last, the strongest first.
    const std::vector<Measurement>& measurements() const { return _measurements; }
    const std::vector<GsmMeasurement>& gsmMeasurements() const { return _gsmMeasurements; }
    /// Of a dedicated connection; empty without one.
    const std::vector<TransportChannel>& transportChannels() const { return _transportChannels; }
    const std::vector<CompositeChannel>& composites() const { return _composites; }
    /// The access points of the packet contexts that are active.
    const std::vector<std::string>& contexts() const { return _contexts; }

private:
    enum class Session { Registration, Speech, Data };

    void followUser(const PhoneUser& user);
    void rest();
    void enter(RrcState state, Time duration);
    void serve(Session session);
    void disconnect();
    void registerInArea();
    void finishRegistration();
    void measure();
    void changeCell();
    void camp(std::size_t cell);
    void listCells();
    void listGsmCells();
    Measurement::Set setOf(std::size_t cell) const;
    void readChannels();
    bool isDedicated() const { return _rrcState == RrcState::CellDch; }
    bool canSignal() const { return isDedicated() || _rrcState == RrcState::CellFach; }

    const Network& _network;
    Air& _air;
    Random _random;

    Time _now{0};
    std::size_t _serving = 0;
    HeldFor _better;
    Time _camped{0};
    RrcState _rrcState = RrcState::Disconnected;
    Time _until{0};  // the state lasts
    Session _session = Session::Registration;
    int _registeredArea = 0;
    std::optional<Time> _registersAt;

    std::vector<Measurement> _measurements;
    std::vector<GsmMeasurement> _gsmMeasurements;
    std::vector<TransportChannel> _transportChannels;
    std::vector<CompositeChannel> _composites;
    std::vector<std::string> _contexts{"internet"};
    bool _hasMeasured = false;
};

}  // namespace kelvo::simulation::utran
