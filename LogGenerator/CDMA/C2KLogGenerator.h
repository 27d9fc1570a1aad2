#pragma once

#include <memory>

#include "LogGenerator/OSKLogGenerator.h"

namespace kelvo {

/// The generator of CDMA2000 modems, 1x and EV-DO. Its screens come from the template "C2KTemplate": a text in it is
/// the lookup key of the value that is to be shown there, and a decoded value is shown at every place that names its
/// key. Beside the keys of every generator the state has "Lookup" (lookup key to the places in the live display) and
/// the running values of the data rates and the frame error rate; the generator itself keeps the raw packets alone.
class C2KLogGenerator final : public OSKLogGenerator {
public:
    C2KLogGenerator() { logCreation(); }
    static std::unique_ptr<LogGenerator> generator() { return std::make_unique<C2KLogGenerator>(); }

    void updateState(Dictionary& state, ByteView data) override;
    Value generateLogUsingState(Dictionary& state) override;
    DictionaryRef getStartCommand() override;

    /// Decodes one message and keeps its packet for the raw log, also when its decoder refuses it. A message that is
    /// no packet is ignored, and so is a code that was not asked for, but for the line about a wrong log type. With a
    /// null lookup nothing is shown.
    void updateFromLog(ByteView data, const DictionaryRef& usingLookup, Dictionary& usingState);

    /// Fills `storeDisplayIntoDict` with the template's screens, every value still "", and `storeLookupIntoDict` with
    /// the places of each lookup key. What is neither a dictionary nor a string is left out.
    static void processTemplate(const Dictionary& templateDict, const DictionaryRef& storeDisplayIntoDict,
                                Dictionary& storeLookupIntoDict);
    /// The state's display, built on the first call; none, with one line, while the template cannot be loaded.
    static Value getDisplayFromState(Dictionary& state);
};

}  // namespace kelvo
