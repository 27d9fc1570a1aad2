// What a frame of the chart costs while a finger drags it, drawn by the CPU in a window of 412 by 915, with readings
// every two seconds for half an hour and a second line over the first. Prints the processor time of a frame:
//     cmake --build --preset release --target chart_bench && build/release/bin/chart_bench

#include <fmt/format.h>

#include <QGuiApplication>
#include <algorithm>
#include <ctime>
#include <vector>

#include "platform/telephony/TelephonyConstants.h"
#include "tests/support/Record.h"
#include "tests/ui/Scene.h"
#include "ui/TrendChart.h"

namespace {

using namespace kelvo;

constexpr int kFrames = 300;

double processorMs() {
    timespec time{};
    ::clock_gettime(CLOCK_PROCESS_CPUTIME_ID, &time);
    return static_cast<double>(time.tv_sec) * 1000 + static_cast<double>(time.tv_nsec) / 1e6;
}

/// A level that goes up and down like one on a drive, and a neighbor's.
Bytes measurement(int at) {
    const auto level = static_cast<std::uint32_t>(160 + (at * 37 % 61) - (at / 60 % 2) * 40);
    test::Record record(0xB179, 35);
    record.u16(17, 1300).u16(19, 301U + static_cast<std::uint32_t>(at) / 100U).u16(23, level).u16(25, 80);
    return record.u8(27, 1).u16(29, 17).u16(31, level - 20).u16(33, 60).bytes();
}

void drag(test::Scene& scene, TrendChart& chart, double span) {
    chart.zoomBy(span / std::chrono::duration<double>(chart.view().span()).count(), chart.width());
    chart.moveBy(60);
    std::vector<double> frames;
    for (int frame = 0; frame < kFrames; ++frame) {
        const double before = processorMs();
        chart.moveBy(frame / 30 % 2 == 0 ? 5 : -5);
        scene.view().grabWindow();
        frames.push_back(processorMs() - before);
    }
    std::ranges::sort(frames);
    fmt::print("{:>5.0f} s seen: {:.2f} ms a frame in the middle, {:.2f} ms at most but for one in a hundred\n", span,
               frames[kFrames / 2], frames[kFrames * 99 / 100]);
}

}  // namespace

int main(int argc, char** argv) {
    qputenv("QT_QPA_PLATFORM", "offscreen");
    qputenv("QT_QUICK_BACKEND", "software");
    QGuiApplication application(argc, argv);
    test::Scene scene(false, {412, 915});
    scene.ports.onRequest = test::speaking(std::string(kPLLogChannelTechnology_Oskra_LTE));
    scene.connect();
    for (int at = 0; at < 900; ++at) {
        scene.ports.deliver(KelvoModel::kLogChannelPortName, 0, measurement(at));
        scene.pass(std::chrono::seconds(2));
    }
    scene.app().showDetails("/Connected mode LTE Intra-frequency Measurement/Serving Filtered RSRP", 0);
    scene.settle();
    scene.app().details()->findCandidates();
    scene.app().details()->compareWith(0);
    auto* chart = qobject_cast<TrendChart*>(scene.itemOfType("kelvo::TrendChart"));
    for (const double span : {30.0, 300.0, 1000.0, 1700.0}) drag(scene, *chart, span);
}
