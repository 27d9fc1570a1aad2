#include "bench/Families.h"
#include "platform/encodings/PropertyList.h"
#include "platform/telephony/TelephonyConstants.h"

namespace kelvo::bench {
namespace {

Value cell(std::uint32_t number) {
    return Dictionary::make({{"ARFCN", std::to_string(500 + number)},
                             {"BSIC", Dictionary::make({{"Value", std::to_string(number)}})},
                             {"RXLEV", "-" + std::to_string(50 + number % 60) + " dBm"},
                             {"C1", "12"},
                             {"C2", "14"}});
}

/// What a modem sends: a serving cell and others in an array behind its header.
Bytes tree(std::uint32_t i, std::uint32_t neighbors) {
    const ArrayRef list = Array::make({"header"});
    for (std::uint32_t j = 0; j < neighbors; ++j) list->append(cell(i + j));
    return *writeXmlPropertyList(Dictionary::make({{"Serving", cell(i)}, {"Neighbours", list}}));
}

}  // namespace

Family ifxFamily() {
    return {"IFX",
            kPLLogChannelTechnology_IFX,
            {{"mix", vary(12, [](std::uint32_t i) { return tree(i, i % 7); })},
             {"tree of 33 cells", vary(4, [](std::uint32_t i) { return tree(i, 32); })}}};
}

}  // namespace kelvo::bench
