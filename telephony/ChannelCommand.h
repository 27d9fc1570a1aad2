#pragma once

#include <cstddef>
#include <memory>

#include "platform/values/Bytes.h"
#include "platform/values/Result.h"
#include "telephony/RecordFilter.h"

namespace kelvo {

/// What one message from a client asks of its log channel (platform/telephony/LogChannelProtocol.h). A message may ask
/// for several things at once.
struct ChannelCommand {
    bool getTechnology = false;
    bool startStreaming = false;
    std::shared_ptr<const RecordFilter::Codes> ordinaryCodes;  ///< none: not mentioned
    std::shared_ptr<const RecordFilter::Codes> extendedCodes;  ///< none: not mentioned
    std::size_t unknownKeys = 0;                               ///< what a newer client may ask for; ignored

    /// Reads a message. One that is no dictionary, asks for nothing that is known here, or has a value of the wrong
    /// kind is refused as a whole, with the reason.
    static Result<ChannelCommand> parse(ByteView message);
};

}  // namespace kelvo
