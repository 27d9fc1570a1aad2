#include "LogGenerator/CellInfo.h"

#include "LogGenerator/FieldTable.h"
#include "LogGenerator/Framing.h"
#include "platform/Environment.h"
#include "platform/PropertyList.h"
#include "platform/TelephonyConstants.h"

namespace kelvo {

Value payloadPropertyList(ByteView packet) {
    Result<Value> value = readPropertyList(payloadOf(packet));
    return value ? *value : Value();
}

ArrayRef cellInfoArray(ByteView packet) {
    const Value value = payloadPropertyList(packet);
    if (!value) {
        logLine(Level::Error, "Cell Info Array data could not be constructed");
        logLine(Level::Error, "Failed to get Cell Array\n");
        return nullptr;
    }
    return value.array() ? value.array() : Array::make();
}

bool isCell(const Value& cell, std::string_view technology, std::string_view cellType) {
    const auto says = [&](std::string_view key, std::string_view expected) {
        const std::string* text = (*cell.dictionary())[key].string();
        return text != nullptr && *text == expected;
    };
    return cell.dictionary() && says(kPLCellMonitorCellRadioAccessTechnology, technology) &&
           says(kPLCellMonitorCellType, cellType);
}

const Dictionary* firstCell(const Array& cells, std::string_view technology, std::string_view cellType) {
    for (const Value& cell : cells) {
        if (isCell(cell, technology, cellType)) return cell.dictionary().get();
    }
    return nullptr;
}

void showCell(Dictionary& shown, const Dictionary& cell, std::span<const CellField> fields) {
    for (const CellField& field : fields) {
        const Number* number = cell[field.cellKey].number();
        const auto value = number != nullptr ? number->int32() : std::nullopt;
        if (value) {
            print(shown.slot(field.displayKey).text(), *value, decimal);
        } else {
            logLine(Level::Error, field.failure);
        }
    }
}

}  // namespace kelvo
