// Any bytes may come under any log code of GSM/UMTS; none may crash, hang or read outside the record. An input is a row
// of records: a byte that picks the code, a byte with the payload's size (255: all that is left), the payload.

#include <algorithm>
#include <cstdint>

#include "LogGenerator/Framing.h"
#include "LogGenerator/GSMUMTS/OSK_GSMClassIndex.h"
#include "LogGenerator/UnknownDataException.h"

namespace {

using namespace kelvo;

constexpr LogCode kCodes[] = {0x4005, 0x4031, 0x4116, 0x4125, 0x4127, 0x4157,   0x417a,   0x4221,  0x5072, 0x5076,
                              0x512c, 0x5134, 0x5137, 0x51f4, 0x51f5, 0x51f6,   0x51f8,   0x51fb,  0x51fd, 0x51ff,
                              0x7130, 0x7131, 0x7132, 0x7135, 0x7150, 0xff0000, 0xff0001, 0xff0002};

void offer(const ClassIndex& sections, LogCode code, ByteView payload) {
    Bytes record(kPayloadOffset);  // of the record's own size, so that every read past its end is seen
    record.insert(record.end(), payload.begin(), payload.end());
    for (Base* section : *sections.getSubscribers(code)) {
        try {
            section->updateWithData(record, code);
        } catch (const LogCode_0xFF0000::UnknownDataException&) {
        }
    }
}

void feed(const OSK_GSMClassIndex& sections, ByteView input) {
    while (input.size() >= 2) {
        const LogCode code = kCodes[input[0] % std::size(kCodes)];
        const std::size_t left = input.size() - 2;
        const std::size_t size = input[1] == 255 ? left : std::min<std::size_t>(input[1], left);
        offer(sections, code, input.subspan(2, size));
        input = input.subspan(2 + size);
    }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const OSK_GSMClassIndex sections;
    for (const bool lists : {false, true}) {
        for (std::string_view name : sections.getAllNames()) {
            sections.getClass(name)->updateSectionRef(lists ? Value(Array::make()) : Value(Dictionary::make()));
        }
        feed(sections, {data, size});
    }
    return 0;
}
