#pragma once

#include <gtest/gtest.h>

#include <algorithm>
#include <memory>
#include <string>
#include <vector>

#include "model/KelvoModel.h"
#include "platform/system/DirectoryResources.h"
#include "platform/system/Environment.h"
#include "tests/support/CapturedOutput.h"
#include "tests/support/FakePorts.h"
#include "tests/support/FakeTelephony.h"
#include "tests/support/ManualClock.h"
#include "tests/support/ManualQueue.h"
#include "tests/support/Record.h"
#include "tests/support/RecordingLog.h"

namespace kelvo::test {

/// A model on a queue, ports and a telephony service that the test moves.
class MonitoredModel : public testing::Test {
protected:
    using Texts = std::vector<std::string>;
    static constexpr const char* kLocalPort = "com.zorvik.BasebandStateReport.LogChannel";
    static constexpr const char* kLte = "kPLLogChannelTechnology_Oskra_LTE";
    static constexpr const char* kCellPath = "/Serving Cell Info/Physical Cell ID";

    /// The error lines since the last call, in order, every pointer written as %p.
    Texts errors() {
        Texts texts;
        for (const auto& [level, text] : log.lines()) {
            if (level == 3) texts.push_back(withoutAddresses(text));
        }
        log.clear();
        return texts;
    }

    static std::string withoutAddresses(std::string text) {
        for (std::size_t at = text.find("0x"); at != text.npos; at = text.find("0x", at)) {
            text.replace(at, text.find_first_not_of("0123456789abcdef", at + 2) - at, "%p");
        }
        return text;
    }

    /// A serving cell as the service delivers it.
    static Bytes servingCell(std::uint32_t physicalCellId) {
        return Record(0xB0C2, 38).u16(14, physicalCellId).bytes();
    }
    std::optional<Bytes> deliver(const Bytes& message, std::int32_t id = 0) {
        return ports.deliver(kLocalPort, id, message);
    }
    /// The value at `path` of the display tree; "(no node)" when there is none.
    std::string shown(const std::string& path = kCellPath) {
        const NodeRef node = model->nodeAtPath(path);
        if (!node) return "(no node)";
        return node->value() != nullptr ? *node->value() : "(children)";
    }
    std::size_t queries() const {
        return static_cast<std::size_t>(std::count_if(
            ports.sent.begin(), ports.sent.end(), [](const auto& message) { return message.replyLimit.has_value(); }));
    }
    /// A model that streams LTE; what it logged on the way is forgotten.
    void startLte() {
        ports.onRequest = speaking(kLte);
        model->restartMonitor();
        ASSERT_TRUE(model->isConnected());
        log.clear();
        ports.sent.clear();
    }

    std::unique_ptr<KelvoModel> newModel() {
        return std::make_unique<KelvoModel>(
            KelvoModel::Services{.queue = queue,
                                 .ports = ports,
                                 .telephony = telephony,
                                 .updateViewControllerFromModel = [this] { ++updates; },
                                 .connectionChanged = [this] { told.push_back(connectionText(model->connection())); },
                                 .encode = encode});
    }

    ManualQueue queue;
    FakePorts ports;
    FakeTelephony telephony;
    RecordingLog log;
    ManualClock clock;
    DirectoryResources resources{KELVO_RESOURCE_DIR};
    CapturedOutput output;
    Environment::Scope environment{
        {.log = &log, .clock = &clock, .resources = &resources, .standardOutput = output.file()}};
    int updates = 0;  // of the screens
    std::function<Result<Bytes>(const Value&)> encode = writeXmlPropertyList;
    Texts told;  // what was to be said of the connection each time it changed
    std::unique_ptr<KelvoModel> model = newModel();
};

}  // namespace kelvo::test
