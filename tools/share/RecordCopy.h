#pragma once

#include <cstdint>
#include <span>
#include <string_view>

#include "LogGenerator/RecordView.h"
#include "tools/share/Replacer.h"

namespace kelvo {

/// A field that a shared record keeps; what none names is not in it.
struct SharedField {
    std::uint16_t at;
    Raw raw;
    Identity identity = Identity::None;
    std::string_view name = {};  ///< of an identity: as the screens call it
};

/// A record that is made anew, bit by bit, from one to share: everything is zero until it is taken over. What was taken
/// over once stays, so that of fields which lie over each other the first one counts.
class RecordCopy {
public:
    /// `made` is filled: as long as the packet, with its header. Both are borrowed.
    RecordCopy(ByteView packet, Bytes& made, Replacer& replacer);

    /// Reads the original.
    std::int64_t read(std::size_t at, Raw raw) const { return RecordView(_packet).read(at, raw); }
    std::size_t count(std::size_t at, Raw raw) const { return static_cast<std::size_t>(read(at, raw)); }
    std::size_t size() const { return _packet.size(); }
    Replacer& replacer() { return _replacer; }

    void take(std::size_t at, Raw raw) { put(at, raw, read(at, raw)); }
    /// Fields whose places count from `base`: identities replaced, the rest as it stands.
    void take(std::span<const SharedField> fields, std::size_t base = 0);
    /// The same in `count` entries; those that begin behind the record's end are not there.
    void takeEntries(std::size_t start, std::size_t stride, std::size_t count, std::span<const SharedField> fields);
    /// Sets what has not been taken over yet.
    void put(std::size_t at, Raw raw, std::int64_t value);

private:
    ByteView _packet;
    Bytes& _made;
    Bytes _taken;  // a bit for each of the record's
    Replacer& _replacer;
};

}  // namespace kelvo
