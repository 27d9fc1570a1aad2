#include <fmt/format.h>

#include <cmath>
#include <map>

#include "telephony/simulation/LTE/Simulation.h"
#include "tests/tools/KelvoctlTest.h"

namespace kelvo {
namespace {

using namespace std::chrono_literals;

/// A value that the simulated world said it sent.
struct Sent {
    std::size_t record;
    std::string path;
    std::string unit;
    double number;
    double step;  ///< of the record's field
};

/// The captured drive of a simulated modem, and what its world said meanwhile.
struct DriveTest : test::KelvoctlTest {
    void drive(std::chrono::nanoseconds length) {
        simulation::lte::Simulation modem(5);
        CaptureWriter writer = test::captureAt(path("drive.pcap"), Technology::LTE);
        for (;;) {
            const auto message = modem.next();
            if (message.time > length) return;
            ASSERT_TRUE(writer.append(CaptureTime(kStart + message.time), message.bytes));
            times.push_back(message.time);
            note(message.bytes, modem.modem());
        }
    }
    void note(ByteView message, const simulation::lte::Modem& modem) {
        const ByteView packet = message[0] == 0x81 ? message.subspan(2) : message;
        const int code = packet[0] == 1 ? packet[3] | packet[4] << 8 : 0;
        const std::size_t record = times.size();
        const auto send = [&](const std::string& at, const char* unit, double number, double step) {
            sent.push_back({record, at, unit, number, step});
        };
        const std::string connected = "/Connected mode LTE Intra-frequency Measurement/Serving ";
        if (code == 0xB179) {
            send(connected + "Physical Cell ID", "", modem.serving().pci, 0);
            send(connected + "Filtered RSRP", "dBm", modem.reading().filteredRsrp, 0.25);
            send(connected + "Filtered RSRQ", "dB", modem.reading().filteredRsrq, 0.125);
            for (const auto& neighbor : modem.neighbors()) {
                const int channel = modem.neighborsCarrier().downlink;
                send(
                    fmt::format("/Measured Neighbor Cells/PCI {}, EARFCN {}/Filtered RSRP", int{neighbor.pci}, channel),
                    "dBm", neighbor.reading.filteredRsrp, 0.25);
            }
        } else if (code == 0xB17F) {
            send("/Serving Cell Measurements/Physical Cell ID", "", modem.serving().pci, 0);
            send("/Serving Cell Measurements/Measured RSRP", "dBm", modem.reading().rsrp, 0.25);
            send("/Serving Cell Measurements/Measured RSRQ", "dB", modem.reading().rsrq, 0.25);
        } else if (code == 0xB0C2) {
            send("/Serving Cell Info/Cell Identity", "", modem.serving().identity, 0);
            send("/Serving Cell Info/Tracking Area Code", "", modem.serving().trackingArea, 0);
        }
    }

    static constexpr auto kStart = std::chrono::sys_days(std::chrono::year(2026) / 3 / 2) + 9h;
    std::vector<std::chrono::nanoseconds> times;  // of the records
    std::vector<Sent> sent;
};

std::string iso(std::chrono::nanoseconds sinceNine) {
    const auto microseconds = sinceNine / 1us;
    return fmt::format("2026-03-02T{:02}:{:02}:{:02}.{:06}Z", 9 + microseconds / 3'600'000'000,
                       microseconds / 60'000'000 % 60, microseconds / 1'000'000 % 60, microseconds % 1'000'000);
}

TEST_F(DriveTest, WhatIsExportedIsTheSimulatedWorlds) {
    drive(10min);
    const auto done = kelvoctl({"export", "--format", "jsonl", path("drive.pcap")});
    ASSERT_EQ(done.status, 0) << done.errors;
    std::multimap<std::pair<std::size_t, std::string>, nlohmann::json> rows;
    std::size_t at = 0;
    for (std::size_t end = 0; (end = done.output.find('\n', at)) != std::string::npos; at = end + 1) {
        auto row = nlohmann::json::parse(done.output.substr(at, end - at));
        const std::size_t record = row["record"];
        rows.emplace(std::pair(record, row["path"]), std::move(row));
    }
    std::size_t levels = 0;
    for (const Sent& value : sent) {
        const auto row = rows.find({value.record, value.path});
        ASSERT_NE(row, rows.end()) << value.record << " " << value.path;
        EXPECT_EQ(row->second["time"], iso(times[value.record - 1]));
        EXPECT_EQ(row->second.value("unit", ""), value.unit) << value.path;
        EXPECT_NEAR(row->second["number"].get<double>(), value.number, value.step / 2 + 1e-6) << value.path;
        levels += value.unit.empty() ? 0 : 1;
    }
    EXPECT_GT(levels, 3000U);
    // And no level of the serving cell that the world did not send.
    const auto told = std::ranges::count_if(
        rows, [](const auto& row) { return row.first.second == "/Serving Cell Measurements/Measured RSRP"; });
    EXPECT_EQ(told, std::ranges::count(sent, "/Serving Cell Measurements/Measured RSRP", &Sent::path));
}

}  // namespace
}  // namespace kelvo
