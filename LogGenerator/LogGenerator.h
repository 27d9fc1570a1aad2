#pragma once

#include <cstddef>

#include "platform/values/Bytes.h"
#include "platform/values/Value.h"

namespace kelvo {

/// Decodes the messages of one technology family. It keeps nothing of what it decodes: that lives in the state
/// dictionary, which outlives generators and is passed to every call.
///
/// The state's keys: "Template" (dictionary), "Display" (dictionary; the live values, which sections update in place),
/// "ExtraInfo" (dictionary), "Lookup" (dictionary, CDMA only), "DisplayState" (data: the raw log since the last
/// rebuild; cell-monitor generator: the tree as received) and "History" (array of snapshots, oldest first, at most 5).
class LogGenerator {
public:
    virtual ~LogGenerator() = default;
    LogGenerator(const LogGenerator&) = delete;
    LogGenerator& operator=(const LogGenerator&) = delete;

    /// Decodes one message of the log channel into the state. `data` is borrowed for the call.
    virtual void updateState(Dictionary& state, ByteView data) = 0;
    /// What the screens show: a tree of dictionaries, arrays and strings, or none. Records a snapshot in the history,
    /// so it is called once per rebuild of the display.
    virtual Value generateLogUsingState(Dictionary& state) = 0;
    /// The command that makes the service stream this family's records.
    virtual DictionaryRef getStartCommand() = 0;
    /// From now on at most so many bytes of raw records are kept between two rebuilds of the display; what comes beyond
    /// is decoded all the same, and more than that kept already is forgotten. Without a limit everything is kept.
    virtual void limitRawLog(std::size_t /*bytes*/) {}
    /// Whether messages are log packets, with a code and a time in each; else they are trees.
    virtual bool takesPackets() const { return true; }
    /// The contents of a snapshot file.
    virtual ArrayRef getSaveContentsFromState(Dictionary& state) = 0;

    /// Appends a snapshot of the state to its "History" and drops the oldest beyond five.
    static void updateHistoryInState(Dictionary& state);

protected:
    LogGenerator() = default;
    /// Writes the line that tells of a new generator, whose constructor knows at which point it is due.
    void logCreation() const;
};

}  // namespace kelvo
