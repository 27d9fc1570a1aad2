#pragma once

#include <signal.h>

#include <algorithm>
#include <map>
#include <sstream>

#include "platform/host/Capture.h"
#include "platform/telephony/TelephonyProtocol.h"
#include "tests/support/PseudoTerminal.h"
#include "tests/telephony/DaemonFixture.h"

namespace kelvo::test {

using Records = std::vector<std::string>;

/// Ordinary codes of each family, of one equipment each: their records come from the drive's beginning on.
inline const std::vector<int> kGsmCodes{0x5072, 0x5076, 0x512C, 0x5134, 0x5137, 0x51F4,
                                        0x51F5, 0x51F6, 0x51F8, 0x51FB, 0x51FD, 0x51FF};
inline const std::vector<int> kUmtsCodes{0x4005, 0x4031, 0x4116, 0x4125, 0x4127, 0x4157, 0x417A, 0x4221};
inline const std::vector<int> kMobilityCodes{0x7130, 0x7131, 0x7132, 0x7135, 0x7150};
inline const std::vector<int> kCdmaCodes{0x108A, 0x1183, 0x1192, 0x119C, 0x119D, 0x127E, 0x12B6, 0x134F};
inline const std::vector<int> kLteCodes{0xB0C1, 0xB0C2, 0xB179, 0xB17F, 0xB180, 0xB186};
inline const std::vector<int> kUtranCodes{0xD00A, 0xD00C, 0xD00E, 0xD0E0, 0xD0E2};

/// The packet in a service's message: what follows its prefix of two bytes, which no modem sends.
inline std::string packetIn(const std::string& message) { return message[0] == '\x81' ? message.substr(2) : message; }

inline QString captureOf(const char* family) { return QString(KELVO_CAPTURES) + "/" + family + ".pcap"; }

/// What a modem can send of a bundled capture: its ordinary records.
inline Records ordinaryRecords(const char* family) {
    auto capture = CaptureReader::open(captureOf(family).toStdString());
    EXPECT_TRUE(capture);
    Records records;
    while (const auto packet = *capture->next()) {
        const std::string record = packetIn(std::string(textOf(packet->bytes)));
        if (record[0] == 1) records.push_back(record);
    }
    return records;
}

/// Where `part` stands in one piece in `whole`; `whole.size()` where it does not.
inline std::size_t placeOf(const Records& part, const Records& whole) {
    return static_cast<std::size_t>(std::search(whole.begin(), whole.end(), part.begin(), part.end()) - whole.begin());
}

/// Whether `part` are records of `whole`, in its order.
inline bool isIn(const Records& part, const Records& whole) {
    auto from = whole.begin();
    for (const std::string& record : part) {
        from = std::find(from, whole.end(), record);
        if (from == whole.end()) return false;
        ++from;
    }
    return true;
}

/// The service at the port of a played modem: both programs as they are, a pseudo-terminal between them, and a client.
class PortTest : public DaemonFixture {
protected:
    void TearDown() override {
        for (QProcess* program : {&_daemon, &_modem}) {
            program->kill();
            program->waitForFinished(10'000);
        }
    }
    void plugModemIn(const QStringList& arguments) {
        _modem.setProgram(KELVO_MODEM);
        _modem.setArguments(arguments + QStringList{"--on", link()});
        _modem.start();
        ASSERT_TRUE(runUntil([this] { return _modem.canReadLine() || _modem.state() == QProcess::NotRunning; }));
        ASSERT_EQ(_modem.readLine().trimmed(), link()) << _modem.readAllStandardError().toStdString();
    }
    /// The service at `port`, whose log the test reads, and a client that streams.
    void serve(const QString& port, const char* technology, const std::vector<int>& codes) {
        _daemon.setStandardErrorFile(QString::fromStdString(_log.path));  // of a terminal: it logs there
        stream({"--port", port, "--technology", technology}, codes);
    }
    void serve(const char* technology, const std::vector<int>& codes) { serve(link(), technology, codes); }
    void stream(const QStringList& arguments, const std::vector<int>& codes) {
        startDaemon(arguments);
        client = std::make_unique<DaemonClient>(_ports, *_connection);
        ASSERT_TRUE(client->remote);
        client->stream(codes);
    }
    bool receive(std::size_t records) {
        return runUntil([&] { return client->records.size() >= records; });
    }
    /// The first records that another source of the service gives straight.
    Records straight(const QStringList& source, const std::vector<int>& codes, std::size_t count) {
        stream(source + QStringList{"--speed", "max"}, codes);
        EXPECT_TRUE(receive(count));
        Records packets;
        for (std::size_t i = 0; i < std::min(count, client->records.size()); ++i)
            packets.push_back(packetIn(client->records[i]));
        leave();
        stopDaemon();
        return packets;
    }
    void leave() {
        client.reset();
        _connection.reset();
    }
    DictionaryRef status() {
        const auto port = _ports.openRemote(kPLTelephonyServicePort);
        if (!port) return Dictionary::make({});
        const auto request = writeXmlPropertyList(Dictionary::make({{kPLGetStatus, kPLGetStatus}}));
        const auto answer = port->request(0, *request, 1s, 1s);
        return answer ? readPropertyList(*answer)->dictionary() : Dictionary::make({});
    }
    std::string state() {
        const auto answer = status();
        const std::string* text = (*answer)["State"].string();
        return text != nullptr ? *text : "";
    }
    std::string portState() {
        const auto answer = status();
        const auto& port = (*answer)["Port"].dictionary();
        return port ? *(*port)["State"].string() : "";
    }
    /// One of the port's counts.
    std::int64_t count(const char* key) {
        const auto answer = status();
        const auto& port = (*answer)["Port"].dictionary();
        return port && (*port)[key].number() != nullptr ? (*port)[key].number()->integer() : -1;
    }
    /// Ends the modem: what it says that it has sent and spoilt.
    std::map<std::string, std::int64_t> tally() {
        _modem.terminate();
        EXPECT_TRUE(_modem.waitForFinished(10'000));
        std::map<std::string, std::int64_t> counts;
        std::istringstream text(_modem.readAllStandardOutput().toStdString());
        std::int64_t number = 0;
        for (std::string name; text >> name >> number;) counts[name] = number;
        return counts;
    }
    /// The service's log so far, without the lines' times.
    Records lines() {
        for (Bytes more = _log.read(); !more.empty(); more = _log.read()) _logged += textOf(more);
        Records lines;
        std::istringstream text(_logged);
        for (std::string line; std::getline(text, line);) {
            line.erase(line.find_last_not_of('\r') + 1);
            const std::size_t said = line.find(kProgram);
            lines.push_back(said == std::string::npos ? line : line.substr(said + kProgram.size()));
        }
        return lines;
    }
    bool says(const std::string& line) {
        return runUntil([&] {
            const Records all = lines();
            return std::find(all.begin(), all.end(), line) != all.end();
        });
    }
    std::size_t descriptorsOfTheService() const {
        std::size_t count = 0;
        for (const auto& entry :
             std::filesystem::directory_iterator("/proc/" + std::to_string(_daemon.processId()) + "/fd"))
            count += entry.path().empty() ? 0 : 1;
        return count;
    }
    QString link() const { return QString::fromStdString(_temporary.file("modem")); }
    void pullOrPutPlug() const { ::kill(static_cast<pid_t>(_modem.processId()), SIGUSR1); }

    std::unique_ptr<DaemonClient> client;
    QProcess _modem;
    PseudoTerminal _log;
    std::string _logged;
    static inline const std::string kProgram = "kelvo-telephonyd: ";
};

}  // namespace kelvo::test
