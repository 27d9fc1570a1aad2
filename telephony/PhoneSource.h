#pragma once

#include <map>
#include <memory>

#include "platform/system/Lifetime.h"
#include "platform/system/MainQueue.h"
#include "platform/system/SteadyTime.h"
#include "telephony/RecordSource.h"
#include "telephony/phone/PhoneRecords.h"
#include "telephony/phone/PhoneService.h"

namespace kelvo {

/// The records that a service of the phone's system can fill: SIM files, cells, data contexts and, of LTE, the levels.
/// While some client streams, each is written when it tells something new, and at least every ten seconds.
class PhoneSource final : public RecordSource {
public:
    /// `queue` outlives the source.
    PhoneSource(std::unique_ptr<phone::PhoneService> service, MainQueue& queue, SteadyTime now);

    /// Beside a modem's port: whether the levels are to come from here, asked each time, and what the port last sent of
    /// a cell.
    void measureOnly(std::function<bool()> when, phone::LastIdle lastIdle);

    std::optional<Technology> technology() const override { return _family; }
    std::string description() const override { return _service->description(); }
    std::string state() const override;
    DictionaryRef phoneStatus() const override;
    const phone::PhoneState& phone() const { return _service->phone(); }

    void start(RecordSink& sink) override { _sink = &sink; }
    void feed() override;
    void clientsWant(const ClientsWishes& wishes) override;
    void end(std::function<void()> done) override { _service->release(std::move(done)); }

private:
    using nanoseconds = std::chrono::nanoseconds;
    /// What was last written under a code, and when.
    struct Written {
        Bytes payload;
        nanoseconds at;
    };

    void phoneChanged();
    void followFamily();
    void write();
    void write(const phone::Content& content);
    void repeatLater();

    const std::unique_ptr<phone::PhoneService> _service;
    MainQueue& _queue;
    const SteadyTime _now;
    std::function<bool()> _measures;  // none: always
    phone::LastIdle _lastIdle;
    RecordSink* _sink = nullptr;
    bool _streaming = false;
    std::optional<Technology> _family;  // stays while the modem does: a phone out of reach keeps its screens
    std::string _modem;                 // whose family it is
    std::map<LogCode, Written> _written;
    std::int64_t _derived = 0;        // records of levels that clients took
    std::optional<nanoseconds> _fed;  // when everything was written anew for one who came
    bool _repeating = false;          // the next look at the clock is on the queue
    Lifetime _lifetime;
};

}  // namespace kelvo
