// The service of the soak test: kelvo_faulty_service FAULT CAPTURE

#include <fmt/format.h>
#include <signal.h>

#include <QCoreApplication>

#include "platform/host/Capture.h"
#include "platform/host/HostMainQueue.h"
#include "platform/host/HostMessagePorts.h"
#include "platform/host/UnixSignals.h"
#include "tests/soak/FaultyService.h"

namespace {

using namespace kelvo;

std::vector<Bytes> messagesOf(CaptureReader& reader) {
    std::vector<Bytes> messages;
    while (true) {
        const auto packet = reader.next();
        if (!packet || !*packet) return messages;
        messages.emplace_back((*packet)->bytes.begin(), (*packet)->bytes.end());
    }
}

int fail(std::string_view reason) {
    fmt::print(stderr, "kelvo_faulty_service: {}\n", reason);
    return 1;
}

}  // namespace

int main(int argc, char** argv) {
    const QCoreApplication application(argc, argv);
    const auto fault = argc == 3 ? soak::faultNamed(argv[1]) : std::nullopt;
    if (!fault) return fail("usage: kelvo_faulty_service none|late|garbage|records|flood CAPTURE");
    auto reader = CaptureReader::open(argv[2]);
    if (!reader) return fail(reader.error().reason);
    const auto technology = reader->technology();
    const std::vector<Bytes> messages = messagesOf(*reader);
    if (!technology || messages.empty()) return fail("that is no capture of a modem");
    HostMainQueue queue;
    HostMessagePorts ports;
    soak::FaultyService service(queue, ports, *fault, *technology, messages);
    if (!service.open()) return fail("the control port is taken");
    const UnixSignals endings({SIGINT, SIGTERM}, [](int) { QCoreApplication::quit(); });
    return QCoreApplication::exec();
}
