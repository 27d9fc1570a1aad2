#pragma once

#include <cstddef>
#include <cstdint>
#include <limits>
#include <optional>
#include <string_view>

#include "LogGenerator/DLFVersionReport.h"
#include "LogGenerator/LogGenerator.h"

namespace kelvo {

/// The base of the decoding generators: collects the raw records between two rebuilds of the display and renders a
/// snapshot's contents, the history and one DLF log made of its raw records.
class OSKLogGenerator : public LogGenerator {
public:
    /// The history's snapshots, followed, when a DLF could be made, by a dictionary with "Description" and "DLF".
    ArrayRef getSaveContentsFromState(Dictionary& state) override;
    void limitRawLog(std::size_t bytes) override;

    /// One version report followed by the raw records of the history, oldest first; none after one log line. The
    /// report's place is `reportSize` bytes long.
    static std::optional<Bytes> generateDlfFromState(const Dictionary& state,
                                                     std::size_t reportSize = kDLFVersionReportSize);

protected:
    /// Collects a record, unless it no longer fits.
    void keepRaw(ByteView record);
    /// Moves the collected records into the state's "DisplayState" and begins anew.
    void moveBinDataInto(Dictionary& state);

    Bytes _binData;  ///< the raw records since the display was last rebuilt

private:
    std::size_t _rawLogLimit = std::numeric_limits<std::size_t>::max();
    std::size_t _notKept = 0;  // records since the display was last rebuilt
};

}  // namespace kelvo
