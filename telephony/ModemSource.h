#pragma once

#include <memory>

#include "platform/system/Lifetime.h"
#include "platform/system/MainQueue.h"
#include "platform/system/OutputFile.h"
#include "platform/system/SteadyTime.h"
#include "telephony/RecordSource.h"
#include "telephony/adaptation/AdaptationMeter.h"
#include "telephony/adaptation/RecordAdapter.h"
#include "telephony/line/ModemLines.h"
#include "telephony/wire/Session.h"

namespace kelvo {

/// A modem behind its diagnostic port. The port is open while some client streams, or waits to learn the technology,
/// and a few seconds longer: a modem that nobody watches does no work. One that goes is waited for, and asked anew when
/// it is back; clients notice nothing but the pause. Records of newer layouts are turned into the fixed ones before
/// anybody gets them, and those that cannot be turned are refused and counted.
class ModemSource final : public RecordSource, private wire::Session::Owner, private ModemLine::Listener {
public:
    /// `queue` outlives the source.
    ModemSource(std::unique_ptr<ModemLines> lines, wire::Session::Options options, MainQueue& queue, SteadyTime now);

    /// Writes what the port gives to `file` as well, as it comes.
    void recordFramesTo(OutputFile file) { _frames = std::move(file); }

    /// What the port last sent of an LTE cell (0xB17F); null when there is none. Good until its next record.
    const adaptation::IdleCells::Payload* lastIdle(std::uint32_t earfcn, std::uint16_t pci) {
        return _adapter.lastIdle(earfcn, pci);
    }

    std::optional<Technology> technology() const override { return _session.technology(); }
    void findTechnology() override;
    std::string description() const override { return _lines->description(); }
    std::string state() const override { return _trouble; }
    DictionaryRef portStatus() const override;
    void start(RecordSink& sink) override { _sink = &sink; }
    void clientsWant(const ClientsWishes& wishes) override;
    void end(std::function<void()> done) override;

private:
    using nanoseconds = std::chrono::nanoseconds;
    using State = wire::Session::State;
    using Taken = wire::Session::Taken;

    void sendToModem(ByteView bytes) override;
    Taken takeRecord(ByteView packet, std::uint64_t timestamp) override;
    void lineOpened() override;
    void lineGave(std::span<std::uint8_t> bytes) override;
    void lineClosed(const std::string& reason) override;

    bool isNeeded() const { return !_ending && (_streaming || _now() < _neededUntil); }
    void needAWhile();
    void openLine();
    void dropLine();
    void retry();
    void settle();
    void hangUp();
    void release();
    void arm();
    void tell(const std::string& trouble);
    void finish();
    void recordFrames(ByteView bytes);

    const std::unique_ptr<ModemLines> _lines;
    MainQueue& _queue;
    const SteadyTime _now;
    wire::Session _session;
    adaptation::RecordAdapter _adapter;
    adaptation::AdaptationMeter _meter;
    RecordSink* _sink = nullptr;
    std::unique_ptr<ModemLine> _line;  // none: released, or waiting for the port
    bool _talking = false;             // the line is open, and a session is held on it
    bool _streaming = false;
    bool _waiting = false;              // for the port: the next try is on the queue
    bool _ranBefore = false;            // the line that was tried last led to a modem
    nanoseconds _neededUntil{0};        // though nobody streams
    nanoseconds _pause;                 // before the next try
    std::optional<nanoseconds> _armed;  // when settle() runs next
    std::string _trouble;
    bool _ending = false;         // the service is
    std::function<void()> _done;  // to be told when the modem has been silenced
    std::optional<OutputFile> _frames;
    Lifetime _lifetime;
};

}  // namespace kelvo
