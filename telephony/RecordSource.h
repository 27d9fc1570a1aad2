#pragma once

#include <functional>
#include <optional>
#include <string>

#include "platform/telephony/Technology.h"
#include "platform/values/Value.h"
#include "telephony/RecordFilter.h"
#include "telephony/Recording.h"

namespace kelvo {

/// Where a source leaves its records.
class RecordSink {
public:
    virtual ~RecordSink() = default;

    /// Takes one record, exactly as clients get it; false when no client wants it. `record` is borrowed for the call.
    /// Never blocks.
    virtual bool take(ByteView record) = 0;
    /// True while some client has read all it was given: a source without a clock of its own goes on only then.
    virtual bool isHungry() const = 0;
};

/// What the clients want together. It changes as they come and go.
struct ClientsWishes {
    bool streaming = false;        ///< some client streams
    RecordFilter::Codes ordinary;  ///< the codes that any of these asks the modem for

    bool operator==(const ClientsWishes&) const = default;
};

/// Where the modem's records come from. Main queue only.
class RecordSource {
public:
    virtual ~RecordSource() = default;

    /// Writes every record that a client takes to `recording` as well, with its time.
    void recordTo(Recording recording) { _recording = std::move(recording); }

    /// What a client that asks now is told, for the life of its channel; none: it is not known yet.
    virtual std::optional<Technology> technology() const = 0;
    /// A client wants to know the technology, which is not known.
    virtual void findTechnology() {}
    /// What it is, for people: "the capture drive.pcap".
    virtual std::string description() const = 0;
    /// What there is to say of it at the moment, for people: "the capture has ended", "the modem has gone: it hung up";
    /// empty while records come or may come.
    virtual std::string state() const { return {}; }
    /// What a modem's port has said, given and lost; none: this is no port.
    virtual DictionaryRef portStatus() const { return nullptr; }
    /// What the phone's own services know, without identities; none: they are not asked.
    virtual DictionaryRef phoneStatus() const { return nullptr; }

    /// Gives records to `sink`, which outlives the source's work, from now on. Called once, when the first client
    /// streams.
    virtual void start(RecordSink& sink) = 0;
    /// Some client is hungry again, after none was.
    virtual void feed() {}
    /// What the clients want from now on.
    virtual void clientsWant(const ClientsWishes&) {}
    /// The service ends: calls `done` once the modem has been left in order, in two seconds at most.
    virtual void end(std::function<void()> done) { done(); }

protected:
    /// Hands one record over, and to the recording when a client takes it; false when none does.
    bool hand(RecordSink& sink, const CapturePacket& packet) {
        if (!sink.take(packet.bytes)) return false;
        if (_recording && technology()) _recording->append(*technology(), packet);
        return true;
    }

private:
    std::optional<Recording> _recording;
};

}  // namespace kelvo
