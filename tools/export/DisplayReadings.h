#pragma once

#include <optional>

#include "tools/export/ChosenReadings.h"
#include "tools/export/ReadingRows.h"
#include "tools/export/ValueGlobs.h"
#include "tools/export/WrittenValues.h"

namespace kelvo {

/// The readings of one display, handed on record by record.
class DisplayReadings {
public:
    /// What is handed over outlives it.
    DisplayReadings(Technology technology, const Choice& choice, ValueGlobs& globs, ReadingRows& rows);
    /// Series go with it: call `end` before.
    void end();

    /// Hands on what the record has written to `display`.
    void take(const Moment& moment, const Value& display);

private:
    ReadingRows& _rows;
    WrittenValues _written;
    ChosenReadings _chosen;
};

/// The log code of a message; none for a tree, and for one too short to have any.
std::optional<LogCode> codeOf(Technology technology, ByteView message);

}  // namespace kelvo
