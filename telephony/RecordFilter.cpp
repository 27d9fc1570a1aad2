#include "telephony/RecordFilter.h"

#include "LogGenerator/Framing.h"

namespace kelvo {
namespace {

constexpr std::size_t kEndOfCode = 5;  // the log code lies at offset 3 of the packet

bool contains(const std::shared_ptr<const RecordFilter::Codes>& codes, LogCode code) {
    return codes && codes->test(code & 0xFFFF);
}

}  // namespace

std::optional<LogCode> codeOf(ByteView record) {
    const ByteView packet = stripPrefix(record);
    if (packet.size() < kEndOfCode) return std::nullopt;
    return logCode(packet.data());
}

bool RecordFilter::passes(ByteView record) const {
    if (_everything) return true;
    const auto code = codeOf(record);
    return code && contains(*code >= kExtendedLogCodes ? _extended : _ordinary, *code);
}

}  // namespace kelvo
