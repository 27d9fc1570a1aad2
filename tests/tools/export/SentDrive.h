#pragma once

#include <fmt/format.h>
#include <fnmatch.h>

#include <map>

#include "tests/tools/KelvoctlTest.h"

namespace kelvo::test {

/// A value that the simulated world said it sent.
struct Sent {
    std::size_t record;
    std::string path;  ///< a glob where the world does not know what a list's row is called
    std::string unit;
    double number;
    double tolerance;  ///< half of a step of the record's field
};

/// The captured drive of a simulated modem, and what its world said meanwhile, held against what is exported.
struct SentDrive : KelvoctlTest {
    /// `note` is told the log code of each message, 0 of a tree and of a record of the phone's services.
    template <class Modem, class Note>
    void drive(Modem& modem, std::chrono::nanoseconds length, Note note) {
        CaptureWriter writer = captureAt(path("drive.pcap"), modem.technology());
        for (;;) {
            const auto message = modem.next();
            if (message.time > length) return;
            ASSERT_TRUE(writer.append(CaptureTime(kStart + message.time), message.bytes));
            times.push_back(message.time);
            const ByteView packet = message.bytes[0] == 0x81 ? ByteView(message.bytes).subspan(2) : message.bytes;
            note(packet[0] == 1 ? packet[3] | packet[4] << 8 : 0);
        }
    }
    /// The world has this in the last message.
    void send(std::string at, const char* unit, double number, double tolerance = 0) {
        sent.push_back({times.size(), std::move(at), unit, number, tolerance});
    }

    /// Each value that was sent is exported with its record, unit and time.
    void expectExported() {
        const auto done = kelvoctl({"export", "--format", "jsonl", path("drive.pcap")});
        ASSERT_EQ(done.status, 0) << done.errors;
        std::size_t at = 0;
        for (std::size_t end = 0; (end = done.output.find('\n', at)) != std::string::npos; at = end + 1) {
            auto row = nlohmann::json::parse(done.output.substr(at, end - at));
            const std::size_t record = row["record"];
            rows.emplace(record, std::move(row));
        }
        for (const Sent& value : sent) expectExported(value);
    }
    std::ptrdiff_t exported(const std::string& at) const {
        return std::ranges::count_if(rows, [&](const auto& row) { return row.second["path"] == at; });
    }
    std::ptrdiff_t sentTo(const std::string& at) const { return std::ranges::count(sent, at, &Sent::path); }
    std::ptrdiff_t sentLevels() const {
        return std::ranges::count_if(sent, [](const Sent& value) { return !value.unit.empty(); });
    }

    static constexpr auto kStart = std::chrono::sys_days(std::chrono::year(2026) / 3 / 2) + std::chrono::hours(9);
    std::vector<std::chrono::nanoseconds> times;  // of the messages
    std::vector<Sent> sent;
    std::multimap<std::size_t, nlohmann::json> rows;  // by record

private:
    static std::string iso(std::chrono::nanoseconds sinceNine) {
        const auto microseconds = sinceNine / std::chrono::microseconds(1);
        return fmt::format("2026-03-02T{:02}:{:02}:{:02}.{:06}Z", 9 + microseconds / 3'600'000'000,
                           microseconds / 60'000'000 % 60, microseconds / 1'000'000 % 60, microseconds % 1'000'000);
    }
    void expectExported(const Sent& value) {
        std::string others;
        const auto [begin, end] = rows.equal_range(value.record);
        for (auto row = begin; row != end; ++row) {
            const nlohmann::json& told = row->second;
            const std::string at = told["path"];
            if (::fnmatch(value.path.c_str(), at.c_str(), 0) != 0) continue;
            const bool isNear = told.contains("number") &&
                                std::abs(told["number"].get<double>() - value.number) <= value.tolerance + 1e-6;
            if (isNear && told.value("unit", "") == value.unit && told["time"] == iso(times[value.record - 1])) return;
            others += told.dump() + "\n";
        }
        ADD_FAILURE() << value.record << " " << value.path << " " << value.number << " " << value.unit << ": "
                      << others;
    }
};

}  // namespace kelvo::test
