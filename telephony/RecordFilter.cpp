#include "telephony/RecordFilter.h"

#include "LogGenerator/Framing.h"

namespace kelvo {
namespace {

constexpr std::size_t kEndOfCode = 5;  // the log code lies at offset 3 of the packet

bool contains(const std::shared_ptr<const RecordFilter::Codes>& codes, LogCode code) {
    return codes && codes->test(code & 0xFFFF);
}

}  // namespace

bool RecordFilter::passes(ByteView record) const {
    if (_everything) return true;
    const ByteView packet = stripPrefix(record);
    if (packet.size() < kEndOfCode) return false;
    const LogCode code = logCode(packet.data());
    return contains(code >= kExtendedLogCodes ? _extended : _ordinary, code);
}

}  // namespace kelvo
