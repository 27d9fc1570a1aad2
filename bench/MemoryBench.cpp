// An hour of streaming at 5,000 records a second, as fast as it goes: 18,000,000 records of all families in turn, with
// a rebuild of the display for every two seconds of them. Prints what the process holds after each sixth:
//     build/bench/bin/memory_bench

#include <fmt/format.h>
#include <malloc.h>

#include <array>
#include <cstdlib>
#include <fstream>
#include <memory>
#include <new>
#include <string>

#include "LogGenerator/Factory.h"
#include "bench/Families.h"
#include "model/KelvoModelNode.h"
#include "platform/system/DirectoryResources.h"
#include "platform/system/Environment.h"

namespace {

std::size_t allocations = 0;

}  // namespace

// Every allocation is counted.
void* operator new(std::size_t size) {
    ++allocations;
    if (void* memory = std::malloc(size)) return memory;
    throw std::bad_alloc();
}
void operator delete(void* memory) noexcept { std::free(memory); }
void operator delete(void* memory, std::size_t) noexcept { std::free(memory); }

namespace kelvo {
namespace {

constexpr int kRecords = 18'000'000;
constexpr int kRecordsBetweenRefreshes = 10'000;

long residentKilobytes() {
    std::ifstream status("/proc/self/status");
    for (std::string line; std::getline(status, line);) {
        if (line.starts_with("VmRSS:")) return std::stol(line.substr(6));
    }
    return 0;
}

struct Stream {
    explicit Stream(const bench::Family& family)
        : generator(generatorFromTechnology(family.technology)), messages(family.traffic.front().messages) {}

    void step() { generator->updateState(state, messages[next++ % messages.size()]); }
    void rebuild() {
        nodes.clear();
        tree = KelvoModelNode::makeTreeFromObject(generator->generateLogUsingState(state), nodes);
    }

    std::unique_ptr<LogGenerator> generator;
    std::vector<Bytes> messages;
    Dictionary state{};
    std::size_t next = 0;
    NodeRef tree{};
    NodesByPath nodes{};
};

void run() {
    const DirectoryResources resources(KELVO_RESOURCE_DIR);
    const Environment::Scope environment({.resources = &resources});
    std::array<Stream, 4> streams = {Stream(bench::lteFamily()), Stream(bench::gsmFamily()),
                                     Stream(bench::cdmaFamily()), Stream(bench::utranFamily())};
    std::size_t inRecords = 0;  // allocations while decoding
    for (int i = 0; i < kRecords; ++i) {
        const std::size_t before = allocations;
        streams[i % streams.size()].step();
        inRecords += allocations - before;
        if ((i + 1) % kRecordsBetweenRefreshes == 0) {
            for (Stream& stream : streams) stream.rebuild();
        }
        if ((i + 1) % (kRecords / 6) == 0 || i + 1 == 10 * kRecordsBetweenRefreshes) {
            fmt::print("after {:>10} records: {:>6} KiB resident, {:>8} KiB allocated, {:.2f} allocations a record\n",
                       i + 1, residentKilobytes(), mallinfo2().uordblks / 1024,
                       static_cast<double>(inRecords) / (i + 1));
        }
    }
}

}  // namespace
}  // namespace kelvo

int main() { kelvo::run(); }
