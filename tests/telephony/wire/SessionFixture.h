#pragma once

#include <gtest/gtest.h>

#include <algorithm>
#include <vector>

#include "platform/system/Environment.h"
#include "telephony/wire/Session.h"
#include "tests/support/RecordingLog.h"
#include "tests/telephony/wire/PlainFrame.h"

namespace kelvo::test {

using namespace std::chrono_literals;

/// The body of the one frame that `frame` is, taken apart by hand.
inline Bytes plainBody(Bytes frame) {
    Bytes body;
    EXPECT_EQ(frame.back(), 0x7E);
    for (std::size_t i = 0; i + 1 < frame.size(); ++i)
        body.push_back(frame[i] == 0x7D ? static_cast<std::uint8_t>(frame[++i] ^ 0x20) : frame[i]);
    body.resize(body.size() - 2);
    return body;
}

inline Bytes little32(std::uint32_t value) {
    return {static_cast<std::uint8_t>(value), static_cast<std::uint8_t>(value >> 8),
            static_cast<std::uint8_t>(value >> 16), static_cast<std::uint8_t>(value >> 24)};
}

/// A record's frame body: 16 bytes of header and two of payload.
inline Bytes recordOf(std::uint16_t code, std::uint8_t number = 0, std::uint8_t waiting = 0) {
    return {0x10,
            waiting,
            14,
            0,
            14,
            0,
            static_cast<std::uint8_t>(code),
            static_cast<std::uint8_t>(code >> 8),
            0,
            0,
            0,
            0,
            0,
            0,
            2,
            1,
            number,
            0};
}
/// The same as a client gets it.
inline Bytes packetOf(std::uint16_t code, std::uint8_t number = 0) {
    Bytes packet = recordOf(code, number);
    packet.erase(packet.begin(), packet.begin() + 3);
    packet[0] = 1;
    return packet;
}
inline Bytes wrapped(std::uint32_t subscription, const Bytes& body) {
    return joined({{0x98, 1, 0, 0}, little32(subscription), body});
}

inline const Bytes kVersionAnswer = [] {
    Bytes answer(47, ' ');
    answer[0] = 0;
    std::ranges::copy(bytesOf("TARGET9"), answer.begin() + 39);
    return answer;
}();
inline const Bytes kBuildIdAnswer = joined({{0x7C, 0, 0, 0, 1, 2, 3, 4, 5, 6, 7, 8}, {'B', '-', '7', 0}});

/// Ranges as the modem of these tests has them: 1: 0x200, 4: 0x210, 5: 0x220, 0xB: 0x201.
inline Bytes rangesAnswer() {
    Bytes answer = {0x73, 0, 0, 0, 1, 0, 0, 0, 0, 0, 0, 0};
    for (std::uint32_t id = 0; id < 16; ++id) {
        const std::uint32_t items = id == 1 ? 0x200 : id == 4 ? 0x210 : id == 5 ? 0x220 : id == 0xB ? 0x201 : 0;
        answer = joined({answer, little32(items)});
    }
    return answer;
}

/// The session beside a modem whose words the test says; time stands still until it says so.
class SessionTest : public testing::Test, public wire::Session::Owner {
protected:
    using State = wire::Session::State;

    SessionTest() { make({.technology = Technology::LTE, .subscription = {}}); }
    void make(wire::Session::Options options) {
        session = std::make_unique<wire::Session>(
            *this, [this] { return now; }, options);
    }
    void sendToModem(ByteView bytes) override { sent.emplace_back(bytes.begin(), bytes.end()); }
    wire::Session::Taken takeRecord(ByteView packet, std::uint64_t timestamp) override {
        if (!hasClient) return wire::Session::Taken::ForNobody;
        taken.emplace_back(packet.begin(), packet.end());
        timestamps.push_back(timestamp);
        return wire::Session::Taken::Delivered;
    }

    void sayRaw(Bytes bytes) { session->receive(bytes); }
    void say(const Bytes& body) { sayRaw(plainFrame(body)); }
    void pass(std::chrono::nanoseconds time) {
        now += time;
        session->tick();
    }
    void want(std::initializer_list<LogCode> codes) {
        wire::RecordCodes set;
        for (const LogCode code : codes) set.set(code);
        session->want(set);
    }
    // The only thing sent since the last look.
    Bytes request() {
        EXPECT_EQ(sent.size(), 1U);
        if (sent.empty()) return {};
        const Bytes body = plainBody(sent.back());
        sent.clear();
        return body;
    }
    // Says that the mask that was asked for is in force.
    void agree() {
        const Bytes asked = request();
        ASSERT_GE(asked.size(), 16U);
        say(maskAnswer(asked));
    }
    static Bytes maskAnswer(const Bytes& asked) {
        return joined({Bytes(asked.begin(), asked.begin() + 8), little32(0), Bytes(asked.begin() + 8, asked.end())});
    }

    // Each takes the session one step on.
    void open() {
        session->begin("port");
        sent.clear();
    }
    void beQuiet() { pass(200ms); }
    void tellVersion() {
        EXPECT_EQ(request(), Bytes{0x00});
        say(kVersionAnswer);
    }
    void tellBuild() {
        EXPECT_EQ(request(), Bytes{0x7C});
        say(kBuildIdAnswer);
    }
    void tellRanges() {
        EXPECT_EQ(request(), (Bytes{0x73, 0, 0, 0, 1, 0, 0, 0}));
        say(rangesAnswer());
    }
    void agreeToEmptyMasks() {
        for (int id = 0; id < 16; ++id) agree();
    }
    void comeToRanges() {
        open();
        beQuiet();
        tellVersion();
        tellBuild();
    }
    void run() {
        comeToRanges();
        tellRanges();
        agreeToEmptyMasks();
        EXPECT_EQ(session->state(), State::Running);
    }
    // Running, with the records of the code coming.
    void runWith(LogCode code = 0xB0C2) {
        want({code});
        run();
        agree();
    }
    std::vector<std::string> lines() {
        std::vector<std::string> texts;
        for (const auto& line : log.lines()) texts.push_back(line.second);
        return texts;
    }

    std::chrono::nanoseconds now{1000s};
    std::vector<Bytes> sent;
    std::vector<Bytes> taken;
    std::vector<std::uint64_t> timestamps;
    bool hasClient = true;
    RecordingLog log;
    Environment::Scope scope{Environment{.log = &log}};
    std::unique_ptr<wire::Session> session;
};

}  // namespace kelvo::test
