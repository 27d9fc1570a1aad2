// What the application does every two seconds when records came: from the generator's display to the tree that the
// screens show, with all values new.

#include <benchmark/benchmark.h>

#include "LogGenerator/Factory.h"
#include "LogGenerator/RecordLedger.h"
#include "bench/Families.h"
#include "model/KelvoModelNode.h"
#include "model/Trends.h"
#include "overview/Tracker.h"
#include "platform/encodings/PropertyList.h"
#include "platform/system/DirectoryResources.h"
#include "platform/system/Environment.h"

namespace kelvo {
namespace {

std::size_t countOf(const KelvoModelNode& node) {
    std::size_t count = 1;
    for (std::size_t i = 0; node.childNodes() != nullptr && i < node.childNodes()->size(); ++i) {
        count += countOf(*(*node.childNodes())[i]);
    }
    return count;
}

void rebuild(benchmark::State& state, std::string_view technology, const std::vector<Bytes>& messages) {
    const DirectoryResources resources(KELVO_RESOURCE_DIR);
    const Environment::Scope environment({.resources = &resources});
    const auto generator = generatorFromTechnology(technology);
    Dictionary kept;
    NodeRef tree;
    NodesByPath nodes;
    for (auto _ : state) {
        state.PauseTiming();
        for (const Bytes& message : messages) generator->updateState(kept, message);
        state.ResumeTiming();
        tree.reset();  // of the rebuild before
        nodes.clear();
        tree = KelvoModelNode::makeTreeFromObject(generator->generateLogUsingState(kept), nodes);
    }
    state.counters["nodes"] = static_cast<double>(countOf(*tree));
}

/// What the trends take of a refresh, when a record has written every value since the one before.
void noteTrends(benchmark::State& state, std::string_view technology, const std::vector<Bytes>& messages) {
    const DirectoryResources resources(KELVO_RESOURCE_DIR);
    const Environment::Scope environment({.resources = &resources});
    const auto generator = generatorFromTechnology(technology);
    Dictionary kept;
    Trends trends;
    Trends::Time now{0};
    for (auto _ : state) {
        state.PauseTiming();
        for (const Bytes& message : messages) generator->updateState(kept, message);
        const Value display = generator->generateLogUsingState(kept);
        NodesByPath nodes;
        KelvoModelNode::makeTreeFromObject(display, nodes);  // which prints the texts
        now += std::chrono::seconds(2);
        state.ResumeTiming();
        trends.note(display, now);
    }
    state.counters["bytes"] = static_cast<double>(trends.bytes());
}

/// What the overview takes of a refresh, when a record has written every value since the one before: working the
/// display out and following what has changed.
void noteOverview(benchmark::State& state, Technology technology, const std::vector<Bytes>& messages) {
    const DirectoryResources resources(KELVO_RESOURCE_DIR);
    const Environment::Scope environment({.resources = &resources});
    const auto generator = generatorFromTechnology(namesOf(technology).identifier);
    Dictionary kept;
    RecordLedger records;
    overview::Tracker tracker;
    overview::Time now{};
    for (auto _ : state) {
        state.PauseTiming();
        for (const Bytes& message : messages) {
            if (records.isFull()) records.forgetAllBut(kept["Display"]);
            const ByteView packet = generator->takesPackets() ? RecordLedger::packetOf(message) : ByteView();
            const RecordLedger::Counted counted(records, packet, now.time_since_epoch());
            generator->updateState(kept, message);
        }
        now += std::chrono::seconds(2);
        state.ResumeTiming();
        tracker.note(overview::observe(technology, kept["Display"]), now);
    }
    state.counters["cells"] = static_cast<double>(tracker.cells().size());
}

/// A cell monitor's tree with 32 cells around.
std::vector<Bytes> fullestIfxTree() {
    std::vector<Bytes> trees;
    for (int i = 0; i < 4; ++i) {
        const ArrayRef gsm = Array::make({"16"});
        const ArrayRef umts = Array::make({"16"});
        for (int cell = 0; cell < 16; ++cell) {
            const std::string level = std::to_string(-80 - (cell + i) % 20) + " dBm";
            gsm->append(Dictionary::make({{"ARFCN", std::to_string(20 + cell)}, {"BSIC", "42"}, {"RSSI", level}}));
            umts->append(Dictionary::make({{"SCN", std::to_string(20 + cell)}, {"RSCP", level}, {"ECN0", "-9.5 dB"}}));
        }
        const Value serving = Dictionary::make({{"Technology", "UMTS"},
                                                {"MCC", "001"},
                                                {"MNC", "01"},
                                                {"LAC", "8449"},
                                                {"CellId", "6553791"},
                                                {"UARFCN", "10562"},
                                                {"SCN", "17"},
                                                {"RSCP", std::to_string(-90 - i) + " dBm"},
                                                {"ECN0", "-8.5 dB"}});
        trees.push_back(*writeXmlPropertyList(Dictionary::make(
            {{"Serving", Dictionary::make({{"Cell", serving}})},
             {"Neighbours", Dictionary::make({{"GSM", gsm}, {"UMTS", umts}})},
             {"Registration", Dictionary::make({{"State", "Registered"}})},
             {"Connection", Dictionary::make({{"State", "Call"}, {"Channel", "DCH"}, {"Errors", "0.2 %"}})}})));
    }
    return trees;
}

void addAll() {
    const auto add = [](const std::string& name, std::string_view technology, const std::vector<Bytes>& messages) {
        const auto run = [=](benchmark::State& state) { rebuild(state, technology, messages); };
        benchmark::RegisterBenchmark(name.c_str(), run)->Unit(benchmark::kMicrosecond);
    };
    add("GSM/UMTS, every list filled", bench::gsmFamily().technology, bench::fullestGSMScreen());
    benchmark::RegisterBenchmark("trends of GSM/UMTS, every list filled", [](benchmark::State& state) {
        noteTrends(state, bench::gsmFamily().technology, bench::fullestGSMScreen());
    })->Unit(benchmark::kMicrosecond);
    const auto addOverview = [](const std::string& name, Technology technology, const std::vector<Bytes>& messages) {
        const auto run = [=](benchmark::State& state) { noteOverview(state, technology, messages); };
        benchmark::RegisterBenchmark(("overview of " + name).c_str(), run)->Unit(benchmark::kMicrosecond);
    };
    addOverview("GSM/UMTS, every list filled", Technology::GSM, bench::fullestGSMScreen());
    addOverview("LTE", Technology::LTE, bench::lteFamily().traffic.front().messages);
    addOverview("CDMA", Technology::CDMA, bench::cdmaFamily().traffic.front().messages);
    addOverview("UTRAN", Technology::UTRAN, bench::utranFamily().traffic.front().messages);
    addOverview("IFX, 32 cells around", Technology::IFX, fullestIfxTree());
    for (const auto& family : {bench::gsmFamily(), bench::lteFamily(), bench::cdmaFamily(), bench::utranFamily()}) {
        add(family.name, family.technology, family.traffic.front().messages);
    }
}

}  // namespace
}  // namespace kelvo

int main(int argc, char** argv) {
    benchmark::Initialize(&argc, argv);
    kelvo::addAll();
    benchmark::RunSpecifiedBenchmarks();
}
