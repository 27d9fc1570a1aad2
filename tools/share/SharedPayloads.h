#pragma once

#include <optional>
#include <string_view>

#include "LogGenerator/LogCode.h"
#include "tools/share/Replacer.h"

/// Property lists: what the phone's own services tell, and the trees of cell monitors. What nobody knows is removed and
/// counted.
namespace kelvo {

/// A text of a kind that names nobody, as a service delivers it; false for one that may hold more than it should.
bool isPlainText(std::string_view text);

/// One value under a key that names `identity`, of a service's making. None when it must go.
Value sharedValue(Replacer& replacer, Identity identity, std::string_view key, const Value& value);

/// One data context, or what stands in its place.
Value sharedContext(Replacer& replacer, const Value& context);

/// The payload of a record of type 255; none when there is nothing in it that can be shared.
std::optional<Bytes> sharedPayload(Replacer& replacer, LogCode code, ByteView payload);

/// A cell monitor's tree; none for one that no screen can show.
Value sharedTree(Replacer& replacer, const Value& tree);

}  // namespace kelvo
