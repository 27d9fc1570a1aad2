#pragma once

#include <chrono>
#include <filesystem>
#include <string>

#include "platform/encodings/PropertyList.h"
#include "platform/system/DirectoryResources.h"
#include "platform/system/Environment.h"
#include "platform/telephony/TelephonyConstants.h"
#include "tests/support/FakePorts.h"
#include "tests/support/FakeTelephony.h"
#include "tests/support/ManualClock.h"
#include "tests/support/ManualQueue.h"
#include "tests/support/ManualWorker.h"
#include "tests/support/RecordingLog.h"
#include "tests/support/TemporaryDirectory.h"
#include "tests/ui/FakeWindow.h"
#include "ui/KelvoApp.h"

namespace kelvo::test {

using namespace std::chrono_literals;

/// The application with a modem whose service sends ready-made trees, on a clock, a queue and ports of the test's own.
class AppWorld {
public:
    AppWorld();

    KelvoApp::Services services();
    /// A file at this path permits saving; it is not there unless the test puts it there.
    std::filesystem::path markerPath() const { return directory.path() / "Carrier Settings.bundle"; }
    void permitSaving() { std::filesystem::create_directory(markerPath()); }
    std::filesystem::path snapshotDirectory() const { return directory.path() / "snapshots"; }

    /// The service delivers a tree. Dictionaries of one entry and the first element of each list do not reach the
    /// screens: that is how this modem family's trees are read.
    void deliver(const Value& tree);
    /// Delivers a tree and lets the two seconds to the next refresh pass.
    void show(const Value& tree);
    void pass(std::chrono::seconds time);
    /// The service dies, and is not there again until `revive`.
    void loseService();
    void reviveService();

    TemporaryDirectory directory;
    RecordingLog log;
    ManualClock clock{1299230102};  // 2011-03-04 09:15:02 UTC
    DirectoryResources resources{KELVO_RESOURCE_DIR};
    Environment::Scope environment{{.log = &log, .clock = &clock, .resources = &resources}};
    ManualQueue queue;
    FakePorts ports;
    FakeTelephony telephony;
    Events events;
    FakePreferences preferences{events};
    ManualWorker worker;
};

/// A tree of two sections with two leaves each and a list of `cells` cells.
Value sampleTree(int cells, const std::string& level = "-95 dBm");

}  // namespace kelvo::test
