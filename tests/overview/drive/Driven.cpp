#include "tests/overview/drive/Driven.h"

#include <fmt/format.h>

#include <algorithm>

namespace kelvo::overview::test {
namespace {

constexpr auto kTolerance = std::chrono::seconds(2);

std::string textOf(Kind kind, Time time, const std::string& from, const std::string& to) {
    const auto milliseconds = std::chrono::duration_cast<std::chrono::milliseconds>(time.time_since_epoch()).count();
    return fmt::format("{:9.3f} s  {}  {} -> {}", static_cast<double>(milliseconds) / 1000, nameOf(kind), from, to);
}

}  // namespace

std::uint32_t Driven::next() {
    const auto message = _modem.next();
    _time = message.time;
    const ByteView packet = _generator->takesPackets() ? RecordLedger::packetOf(message.bytes) : ByteView();
    {
        const RecordLedger::Counted counted(_records, packet, message.time);
        _generator->updateState(_state, message.bytes);
    }
    if (_records.isFull()) _records.forgetAllBut(_state["Display"]);
    _tracker.note(observe(_modem.technology(), _state["Display"]), timeOf(_time));
    return packet.empty() ? 0 : logCode(packet.data());
}

const TrackedCell* Driven::around(std::string_view identity) const {
    const auto& cells = _tracker.cells();
    const auto found = std::ranges::find_if(cells, [&](const auto& cell) { return cell.heard.identity == identity; });
    return found != cells.end() ? &*found : nullptr;
}

const TrackedCell* Driven::onChannel(const std::string& channel) const {
    const auto& cells = _tracker.cells();
    const auto found = std::ranges::find_if(cells, [&](const TrackedCell& cell) {
        return (cell.heard.identity + ",").starts_with(channel + ",") && cell.lastHeard == timeOf(_time);
    });
    return found != cells.end() ? &*found : nullptr;
}

void Driven::expectDistinct(const std::set<std::string>& existing) const {
    std::set<std::string> rows{seen().cell};
    for (const TrackedCell& cell : _tracker.cells()) {
        const std::string& name = cell.heard.identity;
        EXPECT_TRUE(existing.contains(name)) << name;
        EXPECT_TRUE(rows.insert(name).second) << name << " twice";
        for (const std::string& other : rows) {  // "ARFCN 23" or "PSC 5" beside the whole name
            EXPECT_FALSE(other.starts_with(name + ",") || other.ends_with(", " + name)) << name << " and " << other;
        }
    }
}

std::string Driven::fact(const std::vector<Fact>& facts, std::string_view name) {
    const auto found = std::ranges::find(facts, name, &Fact::name);
    return found != facts.end() ? found->text : "(absent)";
}

void Happened::expectIn(const Tracker& tracker) const {
    std::vector<const Event*> events;
    for (const Event& event : tracker.events()) events.push_back(&event);
    for (const One& one : _all) {
        const auto found = std::ranges::find_if(events, [&](const Event* event) {
            const auto apart = event->time - timeOf(one.time);
            return event->kind == one.kind && event->from == one.from && event->to == one.to && apart <= kTolerance &&
                   apart >= -kTolerance;
        });
        if (found != events.end()) {
            events.erase(found);
        } else {
            ADD_FAILURE() << "not listed: " << textOf(one.kind, timeOf(one.time), one.from, one.to);
        }
    }
    for (const Event* event : events) {
        ADD_FAILURE() << "did not happen: " << textOf(event->kind, event->time, event->from, event->to);
    }
}

int Happened::count(Kind kind) const { return static_cast<int>(std::ranges::count(_all, kind, &One::kind)); }

void expectFigure(const std::optional<Measure>& shown, const char* name, double truth, double step) {
    ASSERT_TRUE(shown) << name;
    EXPECT_EQ(shown->name, name);
    EXPECT_NEAR(shown->figure.number, truth, step / 2 + 0.00501) << name;
}

}  // namespace kelvo::overview::test
