#include "telephony/ChannelCommand.h"

#include <fmt/format.h>

#include "platform/encodings/PropertyList.h"
#include "platform/telephony/LogChannelProtocol.h"

namespace kelvo {
namespace {

using CodesRef = std::shared_ptr<const RecordFilter::Codes>;

Result<CodesRef> parseCodes(std::string_view key, const Value& value) {
    if (!value.array()) return Failure{fmt::format("{} is no array", key)};
    auto codes = std::make_shared<RecordFilter::Codes>();
    for (const Value& element : *value.array()) {
        const auto code = element.number() != nullptr ? element.number()->int32() : std::nullopt;
        if (!code || *code < 0 || *code > 0xFFFF)
            return Failure{fmt::format("{} holds something that is no code", key)};
        codes->set(static_cast<std::size_t>(*code));
    }
    return CodesRef(std::move(codes));
}

Result<void> readCodes(const Dictionary::Entry& entry, CodesRef& into) {
    const auto codes = parseCodes(entry.key, entry.value);
    if (!codes) return codes.error();
    into = *codes;
    return {};
}

bool isText(const Value& value, std::string_view text) { return value.string() != nullptr && *value.string() == text; }

Result<void> readEntry(const Dictionary::Entry& entry, ChannelCommand& into) {
    if (entry.key == kPLSetOskraLogCodes) return readCodes(entry, into.ordinaryCodes);
    if (entry.key == kPLSetPlExtraCodes) return readCodes(entry, into.extendedCodes);
    if (entry.key == kPLGetTechnology) {
        into.getTechnology = true;
    } else if (entry.key == kPLSetState) {
        if (!isText(entry.value, kPLStateStreaming))
            return Failure{fmt::format("{} is not \"{}\"", kPLSetState, kPLStateStreaming)};
        into.startStreaming = true;
    } else {
        ++into.unknownKeys;
    }
    return {};
}

}  // namespace

Result<ChannelCommand> ChannelCommand::parse(ByteView message) {
    const auto read = readPropertyList(message);
    if (!read) return read.error();
    if (!read->dictionary()) return Failure{"it is no dictionary"};
    ChannelCommand command;
    for (const Dictionary::Entry& entry : *read->dictionary())
        if (const auto taken = readEntry(entry, command); !taken) return taken.error();
    if (command.unknownKeys == read->dictionary()->size()) return Failure{"it asks for nothing known"};
    return command;
}

}  // namespace kelvo
