#pragma once

#include <functional>
#include <memory>
#include <optional>

#include "platform/system/Lifetime.h"
#include "platform/system/MainQueue.h"
#include "platform/system/SteadyTime.h"
#include "telephony/wire/modem/ModemPort.h"
#include "telephony/wire/modem/PlayedModem.h"

namespace kelvo::modem {

/// Plays a modem at a port: carries bytes between them, in time, and takes the port away while the modem is unplugged.
/// Main queue only.
class ModemPlayer {
public:
    /// `queue` outlives the player. `onPlace` hears where the port is each time that it appears.
    ModemPlayer(std::unique_ptr<PlayedModem> modem, std::unique_ptr<ModemPort> port, MainQueue& queue, SteadyTime now,
                std::function<void(const std::string& place)> onPlace);

    /// Plugs the modem in; the reason when its port cannot be made.
    Result<void> start();
    /// Pulls the plug, or puts it back.
    void togglePlug();

    const Tally& tally() const { return _modem->tally(); }

private:
    using nanoseconds = std::chrono::nanoseconds;

    Result<void> followPlug();
    void pump();
    void pumpAt(nanoseconds time);

    const std::unique_ptr<PlayedModem> _modem;
    const std::unique_ptr<ModemPort> _port;
    MainQueue& _queue;
    const SteadyTime _now;
    const std::function<void(const std::string&)> _onPlace;
    bool _portIsThere = false;
    std::optional<nanoseconds> _nextPump;
    const Lifetime _lifetime;  // tasks on the queue outlive the player
};

}  // namespace kelvo::modem
