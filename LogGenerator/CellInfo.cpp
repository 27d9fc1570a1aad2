#include "LogGenerator/CellInfo.h"

#include "LogGenerator/Framing.h"
#include "platform/Environment.h"
#include "platform/PropertyList.h"
#include "platform/TelephonyConstants.h"

namespace kelvo {

Value payloadPropertyList(ByteView packet) {
    Result<Value> value = readPropertyList(payloadOf(packet));
    return value ? *value : Value();
}

ArrayRef cellsOf(const Value& payload) {
    if (!payload) {
        logLine(Level::Error, "Cell Info Array data could not be constructed");
        logLine(Level::Error, "Failed to get Cell Array\n");
        return nullptr;
    }
    return payload.array() ? payload.array() : Array::make();
}

ArrayRef cellInfoArray(ByteView packet) { return cellsOf(payloadPropertyList(packet)); }

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
            print(shown.slot(field.displayKey).text(), *value, field.shown);
        } else if (field.failure != nullptr) {
            logLine(Level::Error, field.failure);
        }
    }
}

void showServingCell(const DictionaryRef& shown, ByteView packet, std::string_view technology,
                     std::span<const CellField> fields) {
    const ArrayRef cells = cellInfoArray(packet);
    const Dictionary* serving = cells ? firstCell(*cells, technology, kPLCellMonitorCellTypeServing) : nullptr;
    if (serving != nullptr && shown) showCell(*shown, *serving, fields);
}

std::vector<Value> neighborRows(const Array& cells, std::string_view technology, std::span<const CellField> fields) {
    std::vector<Value> rows;
    for (const Value& cell : cells) {
        if (!isCell(cell, technology, kPLCellMonitorCellTypeNeighbor)) continue;
        const DictionaryRef row = Dictionary::make();
        row->reserve(fields.size());
        showCell(*row, *cell.dictionary(), fields);
        rows.emplace_back(row);
    }
    return rows;
}

}  // namespace kelvo
