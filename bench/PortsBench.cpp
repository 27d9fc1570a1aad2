// How many records the service delivers to a client in another process, over real ports. Prints, for records of 100
// bytes, the rate when the source is as fast as the client reads, and what was lost of a steady 20,000 a second for ten
// seconds:
//     build/bench/bin/ports_bench
#include <fmt/format.h>
#include <stdlib.h>
#include <sys/resource.h>
#include <sys/wait.h>
#include <unistd.h>

#include <QCoreApplication>
#include <algorithm>
#include <chrono>
#include <cstring>
#include <filesystem>
#include <optional>

#include "platform/PropertyList.h"
#include "platform/host/HostMainQueue.h"
#include "platform/host/HostMessagePorts.h"
#include "platform/host/HostTelephonyClient.h"
#include "telephony/TelephonyService.h"

namespace {

using namespace kelvo;
using namespace std::chrono_literals;
using std::chrono::steady_clock;

constexpr std::uint32_t kCount = 200'000;

// Numbered records: `perSecond` of them, or as many as a client reads.
class NumberedSource final : public RecordSource {
public:
    NumberedSource(MainQueue& queue, std::optional<double> perSecond) : _queue(queue), _perSecond(perSecond) {
        _record[0] = 1;
        _record[3] = 0xC2;
        _record[4] = 0xB0;
    }
    Technology technology() const override { return Technology::LTE; }
    void start(RecordSink& sink) override {
        _sink = &sink;
        _begin = steady_clock::now();
        if (_perSecond) _timer = _queue.repeat(1ms, [this] { giveUpTo(due()); });
        feed();
    }
    void feed() override {
        if (_perSecond || _sink == nullptr) return;
        for (int i = 0; i < 256 && _given < kCount && _sink->isHungry(); ++i) giveUpTo(_given + 1);
        if (_given < kCount && _sink->isHungry()) _queue.post([this] { feed(); });
    }

private:
    std::uint32_t due() const {
        const double seconds = std::chrono::duration<double>(steady_clock::now() - _begin).count();
        return static_cast<std::uint32_t>(std::min<double>(kCount, seconds * *_perSecond));
    }
    void giveUpTo(std::uint32_t count) {
        for (; _given < count; ++_given) {
            std::memcpy(_record.data() + 13, &_given, sizeof _given);
            _sink->take(_record);
        }
    }

    MainQueue& _queue;
    const std::optional<double> _perSecond;
    Bytes _record = Bytes(100);
    RecordSink* _sink = nullptr;
    steady_clock::time_point _begin;
    std::unique_ptr<RepeatingTimer> _timer;
    std::uint32_t _given = 0;
};

double processorSeconds() {
    rusage usage{};
    ::getrusage(RUSAGE_SELF, &usage);
    return static_cast<double>(usage.ru_utime.tv_sec + usage.ru_stime.tv_sec) +
           static_cast<double>(usage.ru_utime.tv_usec + usage.ru_stime.tv_usec) * 1e-6;
}

// The client: counts until the last number has come.
int receive(const std::filesystem::path& directory) {
    int argc = 0;
    const QCoreApplication application(argc, nullptr);
    HostMessagePorts ports(directory);
    steady_clock::time_point begin;
    std::uint32_t received = 0;
    const auto local = ports.createLocal("client", [&](std::int32_t, ByteView data) {
        if (received++ == 0) begin = steady_clock::now();
        std::uint32_t number = 0;
        std::memcpy(&number, data.data() + 13, sizeof number);
        if (number == kCount - 1) QCoreApplication::quit();
        return Bytes{};
    });
    local.port->schedule();
    HostTelephonyClient client(ports);
    std::unique_ptr<PLServerConnection> connection;
    while (!connection) connection = client.createServerConnection({});
    const auto remote = ports.openRemote(connection->networkMonitorCreateLogChannel("client").portName);
    const auto start = writeXmlPropertyList(
        Dictionary::make({{"SetState", "Streaming"}, {"SetOskraLogCodes", Array::make({0xB0C2})}}));
    if (!remote || !remote->request(0, *start, 1s, std::nullopt)) return 1;
    QCoreApplication::exec();
    const double seconds = std::chrono::duration<double>(steady_clock::now() - begin).count();
    fmt::print("  {} records in {:.2f} s: {:.0f} a second, {} lost; client used {:.2f} s of processor\n", received,
               seconds, received / seconds, kCount - received, processorSeconds());
    return 0;
}

int serve(const std::filesystem::path& directory, std::optional<double> perSecond) {
    int argc = 0;
    const QCoreApplication application(argc, nullptr);
    HostMainQueue queue;
    HostMessagePorts ports(directory);
    NumberedSource source(queue, perSecond);
    TelephonyService service(ports, source);
    if (service.open()) return 1;
    const auto untilClientLeaves = queue.repeat(100ms, [&, seen = false]() mutable {
        seen = seen || service.channelCount() > 0;
        if (seen && service.channelCount() == 0) QCoreApplication::quit();
    });
    QCoreApplication::exec();
    fmt::print("  service used {:.2f} s of processor\n", processorSeconds());
    return 0;
}

template <class Run>
pid_t inChild(Run run) {
    std::fflush(stdout);
    const pid_t child = ::fork();
    if (child == 0) {
        const int status = run();
        std::fflush(stdout);
        ::_exit(status);
    }
    return child;
}

int measure(const char* title, std::optional<double> perSecond) {
    std::string pattern = (std::filesystem::temp_directory_path() / "kelvo-bench-XXXXXX").string();
    if (::mkdtemp(pattern.data()) == nullptr) return 1;
    const std::filesystem::path directory = pattern;
    fmt::print("{}\n", title);
    const pid_t service = inChild([&] { return serve(directory / "ports", perSecond); });
    const pid_t client = inChild([&] { return receive(directory / "ports"); });
    int clientStatus = 1;
    int serviceStatus = 1;
    ::waitpid(client, &clientStatus, 0);
    ::waitpid(service, &serviceStatus, 0);
    std::filesystem::remove_all(directory);
    return clientStatus != 0 || serviceStatus != 0 ? 1 : 0;
}

}  // namespace

int main() {
    return measure("As fast as the client reads:", std::nullopt) +
           measure("20,000 a second for ten seconds:", 20'000.0);
}
