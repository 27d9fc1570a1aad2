#pragma once

#include <gtest/gtest.h>

#include <QProcess>
#include <QProcessEnvironment>

#include "platform/encodings/PropertyList.h"
#include "platform/host/HostMessagePorts.h"
#include "platform/host/HostTelephonyClient.h"
#include "tests/support/EventLoop.h"
#include "tests/support/TemporaryDirectory.h"

namespace kelvo::test {

using namespace std::chrono_literals;

/// A client that has a log channel of a service in another process, and reads what comes.
struct DaemonClient {
    DaemonClient(HostMessagePorts& ports, PLServerConnection& connection) {
        local = ports
                    .createLocal("client",
                                 [this](std::int32_t, ByteView data) {
                                     records.emplace_back(textOf(data));
                                     return Bytes{};
                                 })
                    .port;
        local->schedule();
        remote = ports.openRemote(PLServerConnectionNetworkMonitorCreateLogChannel(connection, "client").portName);
    }
    /// Asks for the records of these codes, or, without any, of a family that has none.
    void stream(const std::vector<int>& codes = {}) const {
        const DictionaryRef start = Dictionary::make({{"SetState", "Streaming"}});
        if (!codes.empty()) {
            const ArrayRef list = Array::make();
            for (const int code : codes) list->append(code);
            start->set("SetOskraLogCodes", list);
        }
        ASSERT_TRUE(remote->request(0, *writeXmlPropertyList(start), 1s, std::nullopt));
    }

    std::vector<std::string> records;
    std::unique_ptr<LocalPort> local;
    std::unique_ptr<RemotePort> remote;
};

/// The service as a program, on ports of its own.
class DaemonFixture : public testing::Test {
protected:
    static void prepare(QProcess& process, const std::filesystem::path& runtime) {
        QProcessEnvironment environment = QProcessEnvironment::systemEnvironment();
        environment.insert("XDG_RUNTIME_DIR", QString::fromStdString(runtime));
        process.setProcessEnvironment(environment);
        process.setProgram(KELVO_TELEPHONYD);
    }
    void startDaemon(const QStringList& arguments) {
        prepare(_daemon, _temporary.path());
        _daemon.setArguments(arguments);
        _daemon.start();
        ASSERT_TRUE(runUntil([&] { return (_connection = _client.createServerConnection({})) != nullptr; }));
    }
    void stopDaemon() {
        _daemon.terminate();
        ASSERT_TRUE(_daemon.waitForFinished(10'000));
        EXPECT_EQ(_daemon.exitStatus(), QProcess::NormalExit);
        EXPECT_EQ(_daemon.exitCode(), 0);
    }
    /// Exit status and what stood on standard error.
    std::pair<int, std::string> run(const QStringList& arguments) {
        QProcess process;
        prepare(process, _temporary.path());
        process.setArguments(arguments);
        process.start();
        if (!process.waitForFinished(10'000)) return {-1, "still running"};
        _output = process.readAllStandardOutput().toStdString();
        return {process.exitCode(), process.readAllStandardError().toStdString()};
    }

    TemporaryDirectory _temporary;
    std::filesystem::path _directory = _temporary.path() / "kelvo/ports";
    HostMessagePorts _ports{_directory};
    HostTelephonyClient _client{_ports};
    std::unique_ptr<PLServerConnection> _connection;
    QProcess _daemon;
    std::string _output;
};

}  // namespace kelvo::test
