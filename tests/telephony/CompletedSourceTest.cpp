#include "telephony/CompletedSource.h"

#include <gtest/gtest.h>

#include "platform/system/Environment.h"
#include "tests/support/ManualQueue.h"
#include "tests/support/RecordingLog.h"
#include "tests/support/TemporaryDirectory.h"
#include "tests/telephony/FakePhone.h"

namespace kelvo {
namespace {

using namespace std::chrono_literals;
using Codes = std::vector<LogCode>;

/// A port whose records and troubles are the test's.
class FakePort final : public RecordSource {
public:
    std::optional<Technology> technology() const override { return spoken; }
    void findTechnology() override { ++searches; }
    std::string description() const override { return "a port"; }
    std::string state() const override { return trouble; }
    void start(RecordSink& sink) override { _sink = &sink; }
    void clientsWant(const ClientsWishes& wanted) override { wishes.push_back(wanted); }
    void end(std::function<void()> done) override { ended = std::move(done); }

    bool give(const Bytes& record) { return _sink->take(record); }

    std::optional<Technology> spoken;
    std::string trouble;
    int searches = 0;
    std::vector<ClientsWishes> wishes;
    std::function<void()> ended;

private:
    RecordSink* _sink = nullptr;
};

class CompletedSourceTest : public testing::Test {
protected:
    void make(std::optional<std::string> node) {
        auto phones = std::make_unique<PhoneSource>(std::unique_ptr<phone::PhoneService>(&phone), queue,
                                                    [this] { return queue.now(); });
        source = std::make_unique<CompletedSource>(std::unique_ptr<RecordSource>(&port), std::move(phones),
                                                   std::move(node), [this](std::uint32_t earfcn, std::uint16_t pci) {
                                                       asked = {earfcn, pci};
                                                       return &last;
                                                   });
    }
    void stream() {
        phone.state = test::ltePhone();
        phone.change();
        source->start(sink);
        source->clientsWant({.streaming = true, .ordinary = {}});
    }

    test::ManualQueue queue;
    test::RecordingLog log;
    Environment::Scope scope{Environment{.log = &log}};
    test::FakePhone& phone = *new test::FakePhone;
    FakePort& port = *new FakePort;
    adaptation::IdleCells::Payload last{};
    std::pair<std::uint32_t, std::uint16_t> asked;
    std::unique_ptr<CompletedSource> source;
    test::KeepingSink sink;
};

TEST_F(CompletedSourceTest, TakesMeasurementsFromThePortAndTheRestFromThePhone) {
    make("/dev/ttyUSB0");
    stream();
    EXPECT_EQ(sink.codes(), (Codes{0xFF0000, 0xFF0001, 0xFF0002}));
    EXPECT_TRUE(port.give({1, 13, 0, 0x7F, 0xB1, 0, 0, 0, 0, 0, 0, 0, 0, 7}));
    EXPECT_EQ(sink.codes(), Codes{0xB17F});
    sink.wantsAny = false;
    EXPECT_FALSE(port.give({1, 13, 0, 0x7F, 0xB1, 0, 0, 0, 0, 0, 0, 0, 0, 7}));
    EXPECT_EQ(port.wishes.size(), 1U);
    EXPECT_EQ(phone.measures, std::vector{true});
}

TEST_F(CompletedSourceTest, MeasuresByThePhoneWhileThePortGivesNothing) {
    last[7] = 0x0A;  // what the port last said of the cell: priority 5
    port.trouble = "the modem has gone: it hung up";
    make("/dev/ttyUSB0");
    stream();
    ASSERT_EQ(sink.records.size(), 4U);
    EXPECT_EQ(sink.records[3][13 + 7], 0x0B);  // and PCI 301's highest bit
    EXPECT_EQ(asked, std::pair(1300U, std::uint16_t{301}));
    port.trouble.clear();
    sink.codes();
    queue.advance(10s);
    EXPECT_EQ(sink.codes(), (Codes{0xFF0000, 0xFF0001, 0xFF0002}));
}

TEST_F(CompletedSourceTest, HasThePortsTechnologyOrElseThePhones) {
    make("/dev/ttyUSB0");
    EXPECT_EQ(source->technology(), std::nullopt);
    source->findTechnology();
    EXPECT_EQ(port.searches, 1);
    phone.state = test::ltePhone();
    phone.change();
    EXPECT_EQ(source->technology(), Technology::LTE);
    port.spoken = Technology::GSM;
    EXPECT_EQ(source->technology(), Technology::GSM);
}

TEST_F(CompletedSourceTest, SaysThatModemManagerHasThePortItself) {
    make("/dev/ttyUSB0");
    phone.state.ports = {{.name = "ttyUSB1"}, {.name = "ttyUSB0", .isDiagnostic = true}};
    stream();
    phone.state.ports = {{.name = "ttyUSB1"}, {.name = "ttyUSB0", .isDiagnostic = true}};
    EXPECT_EQ(source->state(), "");  // it works all the same
    port.trouble = "it cannot be opened: somebody else has it";
    phone.change();
    phone.change();
    EXPECT_EQ(source->state(), "it cannot be opened: somebody else has it; ModemManager has the port ttyUSB0 itself");
    ASSERT_EQ(log.lines().size(), 1U);
    EXPECT_EQ(log.lines()[0].second, "ModemManager has the port ttyUSB0 itself: it gives what it knows");
    sink.codes();
    queue.advance(10s);
    EXPECT_EQ(sink.codes().size(), 4U);  // with what there is
}

TEST_F(CompletedSourceTest, KnowsTheDiagnosticPortOfAModemThatIsLookedFor) {
    port.trouble = "it cannot be opened: there is no diagnostic port";
    make("");
    phone.state.ports = {{.name = "ttyUSB1"}, {.name = "ttyUSB0", .isDiagnostic = true}};
    EXPECT_EQ(source->state(),
              "it cannot be opened: there is no diagnostic port; ModemManager has the port ttyUSB0 itself");
}

TEST_F(CompletedSourceTest, AccusesNobodyOfHavingASocket) {
    port.trouble = "it cannot be opened: no such file";
    phone.whatIsWrong = "the modem is disabled";
    make(std::nullopt);
    phone.state.ports = {{.name = "ttyUSB0", .isDiagnostic = true}};
    EXPECT_EQ(source->state(), "it cannot be opened: no such file; the modem is disabled");
}

TEST_F(CompletedSourceTest, EndsWhenBothHaveEnded) {
    make("");
    int done = 0;
    source->end([&] { ++done; });
    port.ended();
    EXPECT_EQ(done, 0);
    phone.released();
    EXPECT_EQ(done, 1);
}

TEST_F(CompletedSourceTest, RecordsBothWithTheirTimes) {
    test::TemporaryDirectory directory;
    const auto file = directory.path() / "both.pcap";
    make("");
    source->recordTo(Recording(OutputFile::create(file, {}).value()));
    stream();
    // 2026-03-02 09:00:00 UTC: 1,456,477,200 s after 1980-01-06, in 1.25 ms, 16 bits up
    constexpr std::uint64_t kTime = std::uint64_t{1'456'477'200} * 800 << 16;
    Bytes record{1, 13, 0, 0x7F, 0xB1, 0, 0, 0, 0, 0, 0, 0, 0, 7};
    for (std::size_t i = 0; i < 8; ++i) record[5 + i] = static_cast<std::uint8_t>(kTime >> (8 * i));
    EXPECT_TRUE(port.give(record));
    source.reset();
    auto capture = CaptureReader::open(file);
    ASSERT_TRUE(capture);
    EXPECT_EQ(capture->technology(), Technology::LTE);
    std::vector<LogCode> codes;
    CaptureTime time{};
    while (const auto packet = *capture->next()) {
        codes.push_back(*codeOf(packet->bytes));
        if (codes.back() == 0xB17F) time = packet->time;
    }
    EXPECT_EQ(codes, (Codes{0xFF0000, 0xFF0001, 0xFF0002, 0xB17F}));
    EXPECT_EQ(time.time_since_epoch(), 1'772'442'000s);
}

}  // namespace
}  // namespace kelvo
