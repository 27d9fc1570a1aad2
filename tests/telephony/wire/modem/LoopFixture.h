#pragma once

#include <gtest/gtest.h>

#include <algorithm>
#include <memory>
#include <vector>

#include "platform/system/Environment.h"
#include "telephony/SimulationStream.h"
#include "telephony/wire/Session.h"
#include "telephony/wire/modem/PlayedModem.h"
#include "telephony/wire/modem/StreamRecords.h"
#include "tests/support/RecordingLog.h"

namespace kelvo::test {

/// The service's session and a played modem of a simulated drive, with a line between them whose time is the test's.
class LoopTest : public testing::Test, public wire::Session::Owner {
protected:
    using Time = std::chrono::nanoseconds;
    using Packets = std::vector<Bytes>;
    using Generation = simulation::Generation;

    /// A client that wants everything joins a modem of these faults.
    void join(Technology technology, modem::Faults faults, std::uint64_t seed = 1,
              Generation generation = Generation::Of2010) {
        _session = std::make_unique<wire::Session>(
            *this, [this] { return _now; }, wire::Session::Options{.technology = technology, .subscription = {}});
        wire::RecordCodes all;
        all.set();
        _session->want(all);
        const auto drive = [&](std::uint64_t sim) {
            return std::make_unique<modem::StreamRecords>(
                std::make_unique<SimulationStream>(technology, seed + sim, generation));
        };
        _modem = std::make_unique<modem::PlayedModem>(drive(0), faults.has(modem::Fault::TwoSims) ? drive(1) : nullptr,
                                                      faults, seed);
        _modem->plugIn(_now);
        taken.clear();
        _settled = false;
        _session->begin("the modem");
    }
    /// Lets the modem answer to every mask, late as it may be, and forgets what came meanwhile.
    void settleMasks() {
        while (_session->state() != wire::Session::State::Running) step();
        for (const Time end = _now + std::chrono::seconds(30); _now < end;) step();
        taken.clear();
        _settled = true;
    }
    /// Lets time pass until so many packets have come, or the session has ended by itself, or an hour is over.
    void playUntil(std::size_t packets) {
        const Time end = _now + std::chrono::hours(1);
        while (taken.size() < packets && _session->failure().empty() && _now < end) step();
    }
    /// Lets the modem send what it has on its way, and ends the session.
    void finish() {
        _session->end();
        const Time end = _now + std::chrono::seconds(3);
        while (_session->state() != wire::Session::State::Closed && _now < end) step();
        EXPECT_EQ(_session->state(), wire::Session::State::Closed);
    }
    /// To the next thing that either end does; without one, ten milliseconds on.
    void step() {
        followPlug();
        for (int piece = 0; piece < 64 && carry(); ++piece) {  // a flood has no end
        }
        Time next = _now + std::chrono::milliseconds(10);
        if (const auto due = _modem->nextDue()) next = std::min(next, *due);
        if (const auto due = _session->deadline()) next = std::min(next, *due);
        _now = std::max(next, _now + std::chrono::microseconds(100));
        _session->tick();
    }

    void sendToModem(ByteView bytes) override { _modem->receive(bytes, _now); }
    wire::Session::Taken takeRecord(ByteView packet, std::uint64_t) override {
        taken.emplace_back(packet.begin(), packet.end());
        return wire::Session::Taken::Delivered;
    }

    /// The modem's packets of a drive, straight from the simulation.
    static Packets straight(Technology technology, std::uint64_t seed, std::size_t count,
                            Generation generation = Generation::Of2010) {
        SimulationStream stream(technology, seed, generation);
        Packets packets;
        while (packets.size() < count) {
            const ByteView message = stream.next()->bytes;
            if (message[2] == 1)
                packets.emplace_back(message.begin() + 2, message.end());  // behind two bytes of prefix
        }
        return packets;
    }
    std::vector<std::string> lines() const {
        std::vector<std::string> texts;
        for (const auto& line : _log.lines()) texts.push_back(line.second);
        return texts;
    }
    bool said(const std::string& beginning) const {
        return std::ranges::any_of(lines(), [&](const std::string& line) { return line.starts_with(beginning); });
    }
    const wire::PortCounts& counts() const { return _session->counts(); }
    const modem::Tally& tally() const { return _modem->tally(); }

    Packets taken;
    bool _settled = false;
    Time _now{std::chrono::seconds(1000)};
    RecordingLog _log;
    Environment::Scope _scope{Environment{.log = &_log}};
    std::unique_ptr<wire::Session> _session;
    std::unique_ptr<modem::PlayedModem> _modem;

private:
    void followPlug() {
        const bool pluggedIn = _modem->isPluggedIn(_now);
        if (!pluggedIn) {
            _session->lose();
        } else if (!_pluggedIn) {
            _session->begin("the modem");
        }
        _pluggedIn = pluggedIn;
    }
    // In pieces of any size, as a line gives them.
    bool carry() {
        const ByteView output = _modem->output(_now);
        if (output.empty()) return false;
        _piece = (_piece * 7 + 3) % 1000;
        Bytes bytes(output.begin(), output.begin() + static_cast<std::ptrdiff_t>(std::min(output.size(), 1 + _piece)));
        _modem->sent(bytes.size());
        _session->receive(bytes);
        return true;
    }

    bool _pluggedIn = true;
    std::size_t _piece = 1;
};

}  // namespace kelvo::test
