#include "telephony/wire/modem/ModemPlayer.h"

#include <algorithm>
#include <utility>

#include "platform/system/Environment.h"

namespace kelvo::modem {
namespace {

using namespace std::chrono_literals;

constexpr auto kBlocked = 50ms;    // while the reader takes nothing, what it should have had is counted all the same
constexpr int kPiecesPerTurn = 8;  // the reader is heard in between, whatever a flood costs

}  // namespace

ModemPlayer::ModemPlayer(std::unique_ptr<PlayedModem> modem, std::unique_ptr<ModemPort> port, MainQueue& queue,
                         SteadyTime now, std::function<void(const std::string&)> onPlace)
    : _modem(std::move(modem)),
      _port(std::move(port)),
      _queue(queue),
      _now(std::move(now)),
      _onPlace(std::move(onPlace)) {
    _port->onReceived = [this](ByteView bytes) {
        _modem->receive(bytes, _now());
        pump();
    };
    _port->onRoom = [this] { pump(); };
}

Result<void> ModemPlayer::start() {
    _modem->plugIn(_now());
    if (const auto followed = followPlug(); !followed) return followed;
    pump();
    return {};
}

void ModemPlayer::togglePlug() {
    if (_modem->isPluggedIn(_now())) {
        _modem->unplug();
    } else {
        _modem->plugIn(_now());
    }
    pump();
}

Result<void> ModemPlayer::followPlug() {
    const bool pluggedIn = _modem->isPluggedIn(_now());
    if (pluggedIn == _portIsThere) return {};
    if (!pluggedIn) {
        _port->unplug();
        logLine(Level::Notice, "Unplugged");
    } else if (const auto made = _port->plugIn(); !made) {
        return made;
    } else {
        _onPlace(_port->place());
    }
    _portIsThere = pluggedIn;
    return {};
}

void ModemPlayer::pump() {
    if (const auto followed = followPlug(); !followed) {
        logLine(Level::Error, followed.error().reason);
        return pumpAt(_now() + 1s);
    }
    for (int i = 0; i < kPiecesPerTurn; ++i) {
        const ByteView bytes = _modem->output(_now());
        if (bytes.empty()) break;
        const std::size_t taken = _port->send(bytes);
        _modem->sent(taken);
        if (taken == 0) return pumpAt(_now() + kBlocked);
    }
    if (const auto due = _modem->nextDue()) pumpAt(*due);
}

void ModemPlayer::pumpAt(nanoseconds time) {
    if (_nextPump && *_nextPump <= time) return;
    _nextPump = time;
    const auto run = _lifetime.whileAlive([this, time] {
        if (_nextPump == time) _nextPump.reset();
        pump();
    });
    const nanoseconds now = _now();
    if (time > now) {
        _queue.postAfter(time - now, run);
    } else {
        _queue.post(run);
    }
}

}  // namespace kelvo::modem
