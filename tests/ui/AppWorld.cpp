#include "tests/ui/AppWorld.h"

namespace kelvo::test {

AppWorld::AppWorld() {
    ports.onRequest = speaking(std::string(kPLLogChannelTechnology_IFX));
    std::filesystem::create_directory(snapshotDirectory());
}

KelvoApp::Services AppWorld::services() {
    return {queue,
            ports,
            telephony,
            preferences,
            worker,
            [this] { return std::make_unique<FakeWindow>(events); },
            markerPath().string(),
            snapshotDirectory().string()};
}

void AppWorld::deliver(const Value& tree) {
    ports.deliver(KelvoModel::kLogChannelPortName, 0, *writeXmlPropertyList(tree));
}

void AppWorld::show(const Value& tree) {
    deliver(tree);
    pass(2s);
}

void AppWorld::pass(std::chrono::seconds time) {
    clock.advance(time);
    queue.advance(time);
}

void AppWorld::loseService() {
    telephony.reachable = false;
    ports.killPeer();
}

void AppWorld::reviveService() {
    telephony.reachable = true;
    ports.listening = {"service"};
}

Value sampleTree(int cells, const std::string& level) {
    const ArrayRef list = Array::make({"skipped"});
    for (int cell = 0; cell < cells; ++cell) {
        list->append(Dictionary::make({{"Cell ID", std::to_string(100 + cell)}, {"RSRP", level}}));
    }
    return Dictionary::make({{"Serving Cell", Dictionary::make({{"Cell ID", "7"}, {"RSRP", level}})},
                             {"Neighbor Cells", list},
                             {"Registration", "Registered"}});
}

}  // namespace kelvo::test
