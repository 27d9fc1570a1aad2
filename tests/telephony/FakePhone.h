#pragma once

#include <utility>

#include "telephony/RecordSource.h"
#include "telephony/phone/PhoneService.h"

namespace kelvo::test {

/// A service of the phone's system that knows what the test says.
class FakePhone final : public phone::PhoneService {
public:
    void follow(std::function<void()> changed) override { _changed = std::move(changed); }
    void measure(bool wanted) override { measures.push_back(wanted); }
    void release(std::function<void()> done) override { released = std::move(done); }
    const phone::PhoneState& phone() const override { return state; }
    std::string description() const override { return "a phone"; }
    std::string trouble() const override { return whatIsWrong; }
    std::vector<std::string> lacks() const override { return whatLacks; }

    void change() { _changed(); }

    phone::PhoneState state;
    std::string whatIsWrong;
    std::vector<std::string> whatLacks;
    std::vector<bool> measures;
    std::function<void()> released;

private:
    std::function<void()> _changed;
};

/// An LTE phone with a SIM and a cell that is measured.
inline phone::PhoneState ltePhone() {
    using Cell = phone::MonitoredCell::Technology;
    phone::PhoneState phone;
    phone.modem = "0";
    phone.access = "LTE";
    phone.family = Technology::LTE;
    phone.sim.iccid = "8900101000000123456";
    phone.cells = {{.technology = Cell::LTE, .isServing = true, .pid = 301, .uarfcn = 1300}};
    phone.lte = {.rsrp = -100, .rsrq = -8, .rssi = -65};
    phone.contexts.emplace();
    return phone;
}

/// Keeps what it is given.
class KeepingSink final : public RecordSink {
public:
    bool take(ByteView record) override {
        records.emplace_back(record.begin(), record.end());
        return wantsAny;
    }
    bool isHungry() const override { return true; }
    /// The codes of what has come since the last time, with the type in front: 0xFF0001.
    std::vector<LogCode> codes() {
        std::vector<LogCode> codes;
        for (const Bytes& record : std::exchange(records, {})) codes.push_back(*codeOf(record));
        return codes;
    }

    std::vector<Bytes> records;
    bool wantsAny = true;
};

}  // namespace kelvo::test
