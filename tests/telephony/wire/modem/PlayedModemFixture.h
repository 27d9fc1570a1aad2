#pragma once

#include <gtest/gtest.h>

#include <deque>
#include <initializer_list>
#include <memory>
#include <vector>

#include "telephony/wire/modem/PlayedModem.h"
#include "tests/telephony/wire/PlainFrame.h"

namespace kelvo::test {

using Bodies = std::vector<Bytes>;

/// A record of so many bytes of payload, from its length on: its timestamp is all 0x11, its payload all `fill`.
inline Bytes modemRecord(std::uint16_t code, std::uint8_t fill, std::size_t payload = 4) {
    Bytes record(12 + payload, fill);
    record[0] = static_cast<std::uint8_t>(record.size());
    record[1] = static_cast<std::uint8_t>(record.size() >> 8);
    record[2] = static_cast<std::uint8_t>(code);
    record[3] = static_cast<std::uint8_t>(code >> 8);
    for (std::size_t i = 4; i < 12; ++i) record[i] = 0x11;
    return record;
}

/// Records that a test makes up: one every 100 ms.
class TestRecords final : public modem::ModemRecords {
public:
    explicit TestRecords(std::vector<Bytes> records) : _records(std::move(records)) {}
    std::optional<modem::ModemRecord> next() override {
        if (_next == _records.size()) return std::nullopt;
        const auto at = std::chrono::milliseconds(100 * _next);
        return modem::ModemRecord{at, _records[_next++]};
    }

private:
    const std::vector<Bytes> _records;
    std::size_t _next = 0;
};

/// A played modem, and a reader that writes and reads frames made by hand.
class PlayedModemTest : public testing::Test {
protected:
    using Time = modem::PlayedModem::Time;

    void play(std::vector<Bytes> records, modem::Faults faults = {}, std::uint64_t seed = 1,
              std::vector<Bytes> second = {}) {
        _modem = std::make_unique<modem::PlayedModem>(
            std::make_unique<TestRecords>(std::move(records)),
            second.empty() ? nullptr : std::make_unique<TestRecords>(std::move(second)), faults, seed);
        _modem->plugIn(now);
    }
    void write(const Bytes& bytes) { _modem->receive(bytes, now); }
    /// Everything that is sent by now, as it stands.
    Bytes read() {
        Bytes all;
        while (true) {
            const ByteView bytes = _modem->output(now);
            if (bytes.empty()) return all;
            all.insert(all.end(), bytes.begin(), bytes.end());
            _modem->sent(bytes.size());
        }
    }
    /// Everything that is sent for so long.
    Bytes readFor(std::chrono::milliseconds time) {
        Bytes all = read();
        for (const Time end = now + time; now < end;) {
            now += std::chrono::milliseconds(10);
            const Bytes more = read();
            all.insert(all.end(), more.begin(), more.end());
        }
        return all;
    }
    Bytes ask(const Bytes& body) {
        write(plainFrame(body));
        return read();
    }
    /// Asks for all items below 0x200 of LTE, or of another equipment.
    Bytes setMask(std::uint8_t equipment = 0xB) { return ask(maskRequest(equipment, 0x200, 0xFF)); }
    static Bytes maskRequest(std::uint8_t equipment, std::uint16_t items, std::uint8_t fill) {
        Bytes request{0x73,
                      0,
                      0,
                      0,
                      3,
                      0,
                      0,
                      0,
                      equipment,
                      0,
                      0,
                      0,
                      static_cast<std::uint8_t>(items),
                      static_cast<std::uint8_t>(items >> 8),
                      0,
                      0};
        request.insert(request.end(), (items + 7U) / 8, fill);
        return request;
    }
    /// The frame in which a record travels, with so many behind it.
    static Bytes recordFrame(const Bytes& record, std::uint8_t waiting = 0) {
        return plainFrame(joined({{0x10, waiting, record[0], record[1]}, record}));
    }

    Time now{0};
    std::unique_ptr<modem::PlayedModem> _modem;
};

}  // namespace kelvo::test
