#pragma once

#include <gtest/gtest.h>

#include "telephony/ModemSource.h"
#include "tests/support/ManualClock.h"
#include "tests/support/ManualQueue.h"
#include "tests/support/RecordingLog.h"
#include "tests/telephony/wire/SessionFixture.h"

namespace kelvo::test {

/// What a test has of the line that is open.
struct FakeLine final : ModemLine {
    FakeLine(Listener& itsListener, std::shared_ptr<int> alive) : listener(itsListener), count(std::move(alive)) {
        ++*count;
    }
    ~FakeLine() override { --*count; }
    std::string name() const override { return "line"; }
    void open() override { opened = true; }
    void send(ByteView frame) override { sent.emplace_back(frame.begin(), frame.end()); }
    void mayGather(bool may) override { gathers = may; }
    void mute() override { muted = true; }

    Listener& listener;
    std::shared_ptr<int> count;  // a line may outlive its lines
    std::vector<Bytes> sent;
    bool opened = false;
    bool gathers = false;
    bool muted = false;
};

/// Lines that the test answers for.
struct FakeLines final : ModemLines {
    std::string description() const override { return "the modem at line"; }
    Result<std::unique_ptr<ModemLine>> next(ModemLine::Listener& listener, bool again) override {
        ++tries;
        lastAgain = again;
        if (!isThere) return Failure{"No such file or directory"};
        auto made = std::make_unique<FakeLine>(listener, alive);
        line = made.get();
        return std::unique_ptr<ModemLine>(std::move(made));
    }
    void watch(std::function<void()> changed) override { watching = std::move(changed); }

    bool isThere = true;
    bool lastAgain = false;
    int tries = 0;
    std::shared_ptr<int> alive = std::make_shared<int>(0);
    FakeLine* line = nullptr;
    std::function<void()> watching;
};

class ModemSourceTest : public testing::Test, public RecordSink {
protected:
    ModemSourceTest() { make({.technology = Technology::LTE, .subscription = {}}); }
    void make(wire::Session::Options options) {
        auto owned = std::make_unique<FakeLines>();
        lines = owned.get();
        source =
            std::make_unique<ModemSource>(std::move(owned), options, queue, [this] { return queue.now() + 1000s; });
        source->start(*this);
    }
    bool take(ByteView record) override {
        taken.emplace_back(record.begin(), record.end());
        return true;
    }
    bool isHungry() const override { return true; }

    void stream(std::initializer_list<std::size_t> codes) {
        ClientsWishes wishes{.streaming = true, .ordinary = {}};
        for (const std::size_t code : codes) wishes.ordinary.set(code);
        source->clientsWant(wishes);
    }
    void leave() { source->clientsWant({}); }
    void say(const Bytes& body) {
        Bytes frame = plainFrame(body);
        lines->line->listener.lineGave(frame);
    }
    // Answers everything that a modem is asked until it is asked for nothing more.
    void answer() {
        lines->line->listener.lineOpened();
        queue.advance(200ms);
        answerRequests();
    }
    void answerRequests() {
        while (!lines->line->sent.empty()) answerOne();
    }
    void answerOne() {
        FakeLine& line = *lines->line;
        const Bytes asked = plainBody(line.sent.back());
        line.sent.clear();
        if (asked[0] == 0x00) say(kVersionAnswer);
        if (asked[0] == 0x7C) say(kBuildIdAnswer);
        if (asked[0] == 0x73 && asked[4] == 1) say(rangesAnswer());
        if (asked[0] == 0x73 && asked[4] == 3) say(maskAnswer(asked));
    }
    static Bytes maskAnswer(const Bytes& asked) {
        return joined({Bytes(asked.begin(), asked.begin() + 8), Bytes(4), Bytes(asked.begin() + 8, asked.end())});
    }
    std::vector<std::string> texts() const {
        std::vector<std::string> all;
        for (const auto& line : log.lines()) all.push_back(line.second);
        return all;
    }

    ManualQueue queue;
    RecordingLog log;
    ManualClock clock{1'700'000'000};
    Environment::Scope scope{Environment{.log = &log, .clock = &clock}};
    FakeLines* lines = nullptr;
    std::unique_ptr<ModemSource> source;
    std::vector<Bytes> taken;
};

}  // namespace kelvo::test
