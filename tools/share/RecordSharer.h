#pragma once

#include <cstdint>
#include <memory>
#include <optional>

#include "platform/telephony/Technology.h"
#include "telephony/adaptation/RecordAdapter.h"
#include "tools/share/Replacer.h"
#include "tools/share/SharedTimes.h"

namespace kelvo {

/// Makes of each record one that can be shown to anybody: identities have pseudonyms, everything that Kelvo decodes
/// besides stays, and everything that it does not is zero or gone. Records of newer modems come out in the layouts that
/// Kelvo shows; what cannot be turned into these is left out. The records of a file go through one sharer, in their
/// order. What was replaced and left out is in the replacer's tally.
///
/// One thread at a time.
class RecordSharer {
public:
    RecordSharer(const ShareChoices& choices, const Pseudonyms::Secret& secret)
        : _replacer(choices, secret), _times(choices.shiftTimes) {}

    /// `message` as a capture holds it and the service delivers it, of a file of this technology. The message to share,
    /// good until the next call; none when it must be left out.
    std::optional<ByteView> share(ByteView message, Technology technology);
    /// A raw record whatever its technology, and a cell monitor's tree as property list.
    std::optional<ByteView> shareRecord(ByteView message);
    std::optional<ByteView> shareTree(ByteView message);

    Replacer& replacer() { return _replacer; }
    const ShareChoices& choices() const { return _replacer.choices(); }
    SharedTimes& times() { return _times; }
    const ShareTally& tally() const { return _replacer.tally(); }

private:
    std::optional<ByteView> leftOut(std::string_view why);
    bool sharePhoneRecord(ByteView packet);

    Replacer _replacer;
    SharedTimes _times;
    std::unique_ptr<adaptation::RecordAdapter> _adapter = std::make_unique<adaptation::RecordAdapter>();
    Bytes _made;     // the packet that was shared last
    Bytes _message;  // the same behind its prefix, or a tree
};

}  // namespace kelvo
