// Any bytes may come as a snapshot file; what is read can be listed, shown in the terminal and in a window, and turned
// into a capture, and none of its texts reaches a terminal or a status line with a control character.

#include "model/SnapshotFile.h"
#include "platform/telephony/Technology.h"
#include "tests/fuzz/PropertyListRoundTrip.h"
#include "tools/CommandFailure.h"
#include "tools/DisplayJson.h"
#include "tools/DisplayText.h"
#include "tools/SnapshotCapture.h"
#include "ui/SavedScreens.h"

namespace {

using namespace kelvo;

void requireOneLine(const std::string& text) {
    for (const char c : text) fuzz::require(static_cast<unsigned char>(c) >= 0x20 && c != 0x7f, "a control character");
}

void show(const SnapshotFile::Entry& entry) {
    requireOneLine(printable(entry.description.value_or("")));
    requireOneLine(printable(entry.date.value_or("")));
    if (!entry.display) return;
    for (const char c : displayText(entry.display))
        fuzz::require(static_cast<unsigned char>(c) >= 0x20 || c == '\n', "a control character in the display");
    printedJson(jsonFrom(entry.display));
}

void walk(const SavedScreens& screens, const KelvoModelNode& node, const std::string& path) {
    screens.trends().changes(screens.trends().nameAt(path));
    if (node.childNodes() == nullptr) return;
    for (const NodeRef& child : *node.childNodes()) walk(screens, *child, pathByAppending(path, child->displayName()));
}

void showInWindow(const SnapshotFile& snapshot) {
    const SavedScreens screens(snapshot);
    requireOneLine(screens.savedText());
    requireOneLine(screens.note());
    if (screens.topLevelNodes()) walk(screens, *screens.topLevelNodes(), "/");
}

void makeCapture(SnapshotFile& snapshot, Technology technology) {
    try {
        writeSnapshotCapture(snapshot, technology, OutputFile::create("/dev/null").value(), snapshot.odd);
    } catch (const CommandFailure&) {
        // it holds no records
    }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    auto snapshot = SnapshotFile::read("in.kelvo", {data, size});
    if (!snapshot) return 0;
    for (const SnapshotFile::Entry& entry : snapshot->entries) show(entry);
    showInWindow(*snapshot);
    makeCapture(*snapshot, Technology::LTE);
    makeCapture(*snapshot, Technology::IFX);
    return 0;
}
