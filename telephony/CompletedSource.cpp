#include "telephony/CompletedSource.h"

#include <fmt/format.h>

#include <algorithm>
#include <filesystem>
#include <utility>

#include "LogGenerator/Framing.h"
#include "LogGenerator/RecordView.h"
#include "platform/system/Environment.h"
#include "telephony/wire/Timestamp.h"

namespace kelvo {
namespace {

// When the record was taken, by its own time or else by ours.
CaptureTime timeOf(ByteView record) {
    constexpr std::size_t kTimestamp = 5;
    const RecordView packet(stripPrefix(record));
    const auto low = static_cast<std::uint64_t>(packet.read(kTimestamp, u32));
    const auto high = static_cast<std::uint64_t>(packet.read(kTimestamp + 4, u32));
    const auto time = wire::timeOf(high << 32 | low);
    return time ? CaptureTime(*time) : CaptureTime(clock().now().time_since_epoch());
}

std::string joined(std::string first, const std::string& second) {
    return first + (first.empty() || second.empty() ? "" : "; ") + second;
}

}  // namespace

CompletedSource::CompletedSource(std::unique_ptr<RecordSource> port, std::unique_ptr<PhoneSource> phone,
                                 std::optional<std::string> node, phone::LastIdle lastIdle)
    : _port(std::move(port)), _phone(std::move(phone)), _node(std::move(node)) {
    _phone->measureOnly(
        [this] {
            tellConflict();
            return !_port->state().empty();
        },
        std::move(lastIdle));
}

// The port tells the family of what it sends; one that tells none leaves it to the phone.
std::optional<Technology> CompletedSource::technology() const {
    const auto ofPort = _port->technology();
    return ofPort ? ofPort : _phone->technology();
}

std::string CompletedSource::description() const {
    return fmt::format("{}, completed by {}", _port->description(), _phone->description());
}

std::string CompletedSource::state() const { return joined(joined(_port->state(), conflict()), _phone->state()); }

// Of a port that gives nothing: whether the phone's own services drive it.
std::string CompletedSource::conflict() const {
    if (_port->state().empty() || !_node) return {};
    std::error_code ignored;
    const std::string name = std::filesystem::weakly_canonical(*_node, ignored).filename();
    const auto& ports = _phone->phone().ports;
    const auto held = std::ranges::find_if(
        ports, [&](const phone::DrivenPort& port) { return name.empty() ? port.isDiagnostic : port.name == name; });
    return held != ports.end() ? fmt::format("ModemManager has the port {} itself", held->name) : std::string();
}

void CompletedSource::tellConflict() {
    std::string now = conflict();
    if (now != _conflictTold && !now.empty()) logLine(Level::Warning, "%s: it gives what it knows", now);
    _conflictTold = std::move(now);
}

void CompletedSource::start(RecordSink& sink) {
    _sink = &sink;
    _port->start(*this);
    _phone->start(*this);
}

void CompletedSource::feed() {
    _port->feed();
    _phone->feed();
}

void CompletedSource::clientsWant(const ClientsWishes& wishes) {
    _port->clientsWant(wishes);
    _phone->clientsWant(wishes);
}

void CompletedSource::end(std::function<void()> done) {
    const auto both = std::make_shared<int>(2);
    const auto one = [both, done = std::move(done)] {
        if (--*both == 0) done();
    };
    _port->end(one);
    _phone->end(one);
}

bool CompletedSource::take(ByteView record) { return hand(*_sink, {timeOf(record), record}); }

}  // namespace kelvo
