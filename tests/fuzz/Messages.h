#pragma once

#include <algorithm>
#include <cstdint>

#include "LogGenerator/LogGenerator.h"
#include "model/KelvoModelNode.h"
#include "platform/system/DirectoryResources.h"
#include "platform/system/Environment.h"

namespace kelvo::fuzz {

/// Reads every line, so that all of them are formatted, and keeps none.
class ReadingLog final : public SystemLog {
public:
    bool wants(Level) const override { return true; }
    void write(Level, std::string_view) override {}
};

/// Cuts `data` into messages, each behind its length in two bytes, little-endian; the last one may be cut short.
template <class Each>
void forEachMessage(ByteView data, Each each) {
    while (data.size() >= 2) {
        const std::size_t stated = data[0] | static_cast<std::size_t>(data[1]) << 8;
        const std::size_t size = std::min(stated, data.size() - 2);
        each(data.subspan(2, size));
        data = data.subspan(2 + size);
    }
}

/// What the screens ask for at a refresh: the display, its history kept on the way, as a tree.
inline void rebuildDisplay(LogGenerator& generator, Dictionary& state) {
    NodesByPath nodesByPath;
    KelvoModelNode::makeTreeFromObject(generator.generateLogUsingState(state), nodesByPath);
}

/// Feeds the messages to a new generator on a new state, with a rebuild of the display after every fourth and the saved
/// contents at the end.
template <class Generator>
void decode(ByteView data) {
    static const DirectoryResources kResources(KELVO_RESOURCE_DIR);
    static DictionaryRef loadedTemplate;  // read once, which takes longer than most inputs
    ReadingLog log;
    const Environment::Scope environment({.log = &log, .resources = &kResources});
    Dictionary state;
    if (loadedTemplate) state.set("Template", loadedTemplate);
    Generator generator;
    int messages = 0;
    forEachMessage(data, [&](ByteView message) {
        const Bytes exact(message.begin(), message.end());  // so that a read past its end is seen
        generator.updateState(state, exact);
        if (++messages % 4 == 0) rebuildDisplay(generator, state);
    });
    rebuildDisplay(generator, state);
    generator.getSaveContentsFromState(state);
    loadedTemplate = state["Template"].dictionary();
}

}  // namespace kelvo::fuzz
