#pragma once

#include "LogGenerator/LogGenerator.h"

namespace kelvo {

/// The generator of modems whose service sends ready-made cell-monitor trees: each message is one property list, in any
/// encoding, of dictionaries, arrays and strings. It replaces the whole display. Beside a text that is a number
/// stands the number, as beside a record's. The generator has no template and keeps nothing: all is in the state.
class GSMLogGenerator final : public LogGenerator {
public:
    GSMLogGenerator() { logCreation(); }
    static std::unique_ptr<LogGenerator> generator() { return std::make_unique<GSMLogGenerator>(); }

    /// The tree without its one-entry dictionaries below the top, and without the first element of every array.
    /// Recursive: a tree that was read is at most `kMaxPropertyListDepth` deep. Throws AssertionFailure for a value
    /// that is neither dictionary, array nor string; the elements that are dropped are not looked at.
    static Value processObject(const Value& object);
    /// The value of a dictionary's only entry; none for anything else.
    static Value canCollapse(const Value& object);

    /// Throws AssertionFailure, and leaves the state as it was, when the data is no tree that this generator shows.
    void updateState(Dictionary& state, ByteView data) override;
    Value generateLogUsingState(Dictionary& state) override;
    DictionaryRef getStartCommand() override;
    bool takesPackets() const override { return false; }
    /// The history's snapshots alone: these modems send no raw records.
    ArrayRef getSaveContentsFromState(Dictionary& state) override;
};

}  // namespace kelvo
