#include "telephony/wire/Answers.h"

#include <algorithm>

#include "telephony/wire/LittleEndian.h"
#include "telephony/wire/Protocol.h"
#include "telephony/wire/RecordConfiguration.h"

namespace kelvo::wire {
namespace {

bool concernsMask(Operation operation) { return operation == Operation::SetMask || operation == Operation::GetMask; }

// How much of a request tells it from the others: up to its equipment, or its operation, or its command.
std::size_t keySize(ByteView request) {
    const auto configuration = parseConfigurationRequest(request);
    if (!configuration) return 1;
    return concernsMask(configuration->operation) ? 12 : 8;
}

bool refuses(ByteView request, ByteView body) {
    if (refusalText(body[0]).empty()) return false;
    const ByteView echo = body.subspan(1);
    const std::size_t key = keySize(request);
    return echo.size() >= key && std::ranges::equal(echo.first(key), request.first(key));
}

Match matchConfiguration(const ConfigurationRequest& request, ByteView body) {
    const auto operation = parseConfigurationRequest(body);
    if (!operation) return Match::TooShort;
    if (operation->operation != request.operation) return Match::No;
    const auto answer = parseConfigurationAnswer(body);
    if (!answer) return Match::TooShort;
    if (!concernsMask(request.operation)) {
        return answer->status != 0 || parseRanges(answer->data) ? Match::Answer : Match::TooShort;
    }
    const auto equipment = equipmentOf(answer->data);
    if (!equipment) return answer->status != 0 ? Match::Answer : Match::TooShort;
    if (equipment != equipmentOf(request.data)) return Match::No;
    return answer->status != 0 || parseMask(answer->data) ? Match::Answer : Match::TooShort;
}

}  // namespace

Match match(ByteView request, ByteView body) {
    if (request.empty() || body.empty() || std::ranges::equal(request, body)) return Match::No;
    if (refuses(request, body)) return Match::Refusal;
    if (body[0] != request[0]) return Match::No;
    if (const auto configuration = parseConfigurationRequest(request)) return matchConfiguration(*configuration, body);
    const bool version = body[0] == static_cast<std::uint8_t>(Command::Version);
    return body.size() >= (version ? kShortestVersionAnswer : kBuildIdTextAt) ? Match::Answer : Match::TooShort;
}

}  // namespace kelvo::wire
