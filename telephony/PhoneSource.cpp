#include "telephony/PhoneSource.h"

#include <utility>

#include "platform/system/Environment.h"
#include "telephony/PhoneStatus.h"
#include "telephony/wire/Timestamp.h"

namespace kelvo {
namespace {

using namespace std::chrono_literals;
using std::chrono::nanoseconds;

constexpr nanoseconds kPeriod = 10s;
constexpr nanoseconds kLook = 1s;  // how often the clock is looked at

}  // namespace

PhoneSource::PhoneSource(std::unique_ptr<phone::PhoneService> service, MainQueue& queue, SteadyTime now)
    : _service(std::move(service)), _queue(queue), _now(std::move(now)) {
    _service->follow(_lifetime.whileAlive([this] { phoneChanged(); }));
}

void PhoneSource::measureOnly(std::function<bool()> when, phone::LastIdle lastIdle) {
    _measures = std::move(when);
    _lastIdle = std::move(lastIdle);
}

std::string PhoneSource::state() const { return _service->trouble(); }

DictionaryRef PhoneSource::phoneStatus() const {
    auto status = kelvo::phoneStatus(*_service);
    if (_derived > 0) status->set("Derived", _derived);
    return status;
}

void PhoneSource::feed() {
    if (_fed && _now() - *_fed < kLook) return;
    _fed = _now();
    _written.clear();
    write();
}

void PhoneSource::clientsWant(const ClientsWishes& wishes) {
    if (std::exchange(_streaming, wishes.streaming) != wishes.streaming) _service->measure(wishes.streaming);
    _written.clear();  // whoever came has seen nothing yet
    write();
}

void PhoneSource::phoneChanged() {
    followFamily();
    write();
}

void PhoneSource::followFamily() {
    const phone::PhoneState& phone = _service->phone();
    if (std::exchange(_modem, phone.modem) != phone.modem) _family.reset();
    if (!phone.family || phone.family == _family) return;
    const auto before = std::exchange(_family, phone.family);
    if (before && _streaming) {
        logLine(Level::Notice, "The phone is on %s now (%s): clients that stream keep their screens of %s",
                namesOf(*phone.family).name, phone.access, namesOf(*before).name);
    }
}

void PhoneSource::write() {
    if (!_streaming || _sink == nullptr) return;
    const phone::PhoneState& phone = _service->phone();
    for (const phone::Content& content : phone::serviceContents(phone)) write(content);
    const bool measures = !_measures || _measures();
    const auto levels = phone::servingLevels(phone);
    if (levels && measures) write(phone::measurementContent(*levels, _lastIdle));
    repeatLater();
}

void PhoneSource::write(const phone::Content& content) {
    const auto written = _written.find(content.code);
    const bool isNew = written == _written.end() || written->second.payload != content.payload;
    if (!isNew && _now() - written->second.at < kPeriod) return;
    _written[content.code] = {content.payload, _now()};
    const CaptureTime time(clock().now().time_since_epoch());
    const Bytes record = phone::recordOf(content, wire::timestampOf(wire::SystemTime(time)));
    if (hand(*_sink, {time, record}) && content.code < kExtendedLogCodes) ++_derived;
}

void PhoneSource::repeatLater() {
    if (std::exchange(_repeating, true)) return;
    _queue.postAfter(kLook, _lifetime.whileAlive([this] {
        _repeating = false;
        write();
    }));
}

}  // namespace kelvo
