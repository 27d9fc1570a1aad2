// What one refresh of the model costs in the application, without the overview, with it on a phone and with it beside
// the panes, and what the frame after it costs, drawn by the CPU. A connected LTE modem reports 16 neighbors whose
// levels all change, another cell serves every ten refreshes, and 2,000 events are kept. Prints processor time:
//     cmake --build --preset release --target overview_bench && build/release/bin/overview_bench

#include <fmt/format.h>

#include <QGuiApplication>
#include <algorithm>
#include <ctime>
#include <vector>

#include "platform/telephony/TelephonyConstants.h"
#include "tests/support/Record.h"
#include "tests/ui/Scene.h"

namespace {

using namespace kelvo;

constexpr int kEvents = 2000;
constexpr int kRefreshes = 300;
constexpr std::uint32_t kNeighbors = 16;

double processorMs() {
    timespec time{};
    ::clock_gettime(CLOCK_PROCESS_CPUTIME_ID, &time);
    return static_cast<double>(time.tv_sec) * 1000 + static_cast<double>(time.tv_nsec) / 1e6;
}

Bytes measurement(std::uint32_t at, std::uint32_t servingCell) {
    test::Record record(0xB179, 29 + 6 * kNeighbors);
    record.u16(17, 1300)
        .u16(19, servingCell)
        .u16(23, 160 + at * 37 % 61)
        .u16(25, 200 + at * 13 % 70)
        .u8(27, kNeighbors);
    for (std::uint32_t i = 0; i < kNeighbors; ++i) {
        const std::size_t row = 29 + 6 * i;
        record.u16(row, 400 + i).u16(row + 2, 120 + (at * 11 + i * 29) % 80).u16(row + 4, 150 + (at * 7 + i * 17) % 90);
    }
    return record.bytes();
}

void tell(std::vector<double> times, const char* what) {
    std::ranges::sort(times);
    fmt::print("  {}: {:.2f} ms in the middle, {:.2f} ms at most but for one in a hundred\n", what,
               times[times.size() / 2], times[times.size() * 99 / 100]);
}

void measure(test::Scene& scene, const char* what) {
    std::vector<double> refreshes;
    std::vector<double> changes;
    std::vector<double> frames;
    for (std::uint32_t at = 0; at < kRefreshes; ++at) {
        scene.ports.deliver(KelvoModel::kLogChannelPortName, 0, measurement(at, 300 + at / 10 % 7));
        scene.pass(std::chrono::seconds(1));
        const double before = processorMs();
        scene.pass(std::chrono::seconds(1));
        const double refreshed = processorMs();
        scene.view().grabWindow();
        refreshes.push_back(refreshed - before);
        if (at % 10 == 0) changes.push_back(refreshed - before);
        frames.push_back(processorMs() - refreshed);
    }
    fmt::print("{}\n", what);
    tell(std::move(refreshes), "refresh");
    tell(std::move(changes), "refresh with another serving cell");
    tell(std::move(frames), "frame after it");
}

}  // namespace

int main(int argc, char** argv) {
    qputenv("QT_QPA_PLATFORM", "offscreen");
    qputenv("QT_QUICK_BACKEND", "software");
    QGuiApplication application(argc, argv);
    test::Scene scene(false, {412, 915});
    scene.ports.onRequest = test::speaking(std::string(kPLLogChannelTechnology_Oskra_LTE));
    scene.connect();
    for (std::uint32_t at = 0; at < kEvents; ++at) {
        scene.ports.deliver(KelvoModel::kLogChannelPortName, 0, measurement(at, at % 200));
        scene.pass(std::chrono::seconds(2));
    }
    scene.settle();
    measure(scene, "without the overview, 412 by 915");
    scene.app().overview()->show();
    scene.settle();
    measure(scene, "the overview on a phone, 412 by 915");
    scene.view().resize(1200, 800);
    scene.settle();
    measure(scene, "the overview beside the panes, 1200 by 800");
}
