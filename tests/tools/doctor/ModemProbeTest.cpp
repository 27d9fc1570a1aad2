#include "tools/doctor/ModemProbe.h"

#include <gtest/gtest.h>

#include <memory>

#include "telephony/wire/modem/PlayedModem.h"

namespace kelvo {
namespace {

using modem::Fault;
using modem::Faults;
using namespace std::chrono_literals;

/// A modem without records, or with one that comes a thousand times.
class Same final : public modem::ModemRecords {
public:
    std::optional<modem::ModemRecord> next() override {
        if (_count++ == 1000) return std::nullopt;
        return modem::ModemRecord{_count * 10ms, _record};
    }

private:
    int _count = 0;
    const Bytes _record{12, 0, 0xC2, 0xB0, 0, 0, 0, 0, 0, 0, 0, 0};
};

/// A port behind which a modem is played; its time passes while it is waited for.
class PlayedPort final : public ProbedPort {
public:
    explicit PlayedPort(Faults faults) : _modem(std::make_unique<Same>(), nullptr, faults, 1) { _modem.plugIn(now); }
    void write(ByteView bytes) override {
        written.insert(written.end(), bytes.begin(), bytes.end());
        _modem.receive(bytes, now);
    }
    Bytes read(std::chrono::nanoseconds limit) override {
        for (const auto end = now + limit; now <= end; now += 10ms) {
            const ByteView bytes = _modem.output(now);
            if (bytes.empty()) continue;
            const Bytes read(bytes.begin(), bytes.end());
            _modem.sent(read.size());
            return read;
        }
        return {};
    }
    bool isOpen() const override { return open; }

    std::chrono::nanoseconds now{0};
    Bytes written;
    bool open = true;

private:
    modem::PlayedModem _modem;
};

ModemProbe probe(PlayedPort& port) {
    return probeModem(port, [&port] { return port.now; });
}
ModemProbe probe(Faults faults) {
    PlayedPort port(faults);
    return probe(port);
}

TEST(ModemProbe, TellsWhatTheModemIsAndHas) {
    const ModemProbe told = probe(Faults{});
    EXPECT_EQ(told.failure, "");
    EXPECT_EQ(told.target, "PLAYED");
    EXPECT_EQ(told.buildId, "KELVO-MODEM-1");
    ASSERT_TRUE(told.ranges);
    EXPECT_EQ((*told.ranges)[0xB], 0x201U);
    EXPECT_EQ((*told.ranges)[0xC], 0U);
    EXPECT_FALSE(told.isStreaming);
}

TEST(ModemProbe, AsksForNothingThatChangesTheModem) {
    PlayedPort port(Faults{});
    probe(port);
    EXPECT_EQ(port.written, (Bytes{0x00, 0x78, 0xF0, 0x7E,                                               // version
                                   0x7C, 0x93, 0x49, 0x7E,                                               // build
                                   0x73, 0x00, 0x00, 0x00, 0x01, 0x00, 0x00, 0x00, 0x61, 0x9D, 0x7E}));  // ranges
}

TEST(ModemProbe, FindsTheAnswersAmongEverythingElse) {
    for (const Faults& faults : {Faults{Fault::Asynchronous}, Faults{Fault::TwoSims}, Faults{Fault::SlowAnswers},
                                 Faults{Fault::MissingAnswers}, Faults{Fault::Noise},
                                 Faults{Fault::Asynchronous, Fault::TwoSims, Fault::SlowAnswers, Fault::Noise}}) {
        const ModemProbe told = probe(faults);
        EXPECT_EQ(told.failure, "");
        EXPECT_EQ(told.target, "PLAYED");
        EXPECT_EQ(told.buildId, "KELVO-MODEM-1");
        EXPECT_TRUE(told.ranges);
    }
}

TEST(ModemProbe, SeesThatAnotherReaderHasLeftItStreaming) {
    EXPECT_TRUE(probe(Faults{Fault::EarlierSession, Fault::SlowAnswers}).isStreaming);
}

TEST(ModemProbe, GivesUpWhereNobodyAnswersAfterTwoSeconds) {
    PlayedPort port(Faults{Fault::Silent});
    EXPECT_EQ(probe(port).failure, "does not answer: not a diagnostic port, or in use");
    EXPECT_GE(port.now, 2s);
    EXPECT_LE(port.now, 2100ms);
}

TEST(ModemProbe, IsNotTakenInByAnEcho) {
    EXPECT_EQ(probe(Faults{Fault::AtPort}).failure, "answers, but not as a diagnostic port does");
}

TEST(ModemProbe, TellsARefusalInItsWords) {
    const ModemProbe told = probe(Faults{Fault::Security});
    EXPECT_EQ(told.failure, "");
    EXPECT_FALSE(told.ranges);
    EXPECT_EQ(told.rangesFailure, "refused: security");
}

TEST(ModemProbe, EndsWhenTheOtherEndHasGone) {
    PlayedPort port(Faults{Fault::Silent});
    port.open = false;
    EXPECT_EQ(probe(port).failure, "the other end has gone");
}

}  // namespace
}  // namespace kelvo
