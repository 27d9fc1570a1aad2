#include "LogGenerator/PhoneServices/CellInfo.h"

#include <algorithm>

#include "LogGenerator/Base.h"
#include "LogGenerator/Framing.h"
#include "LogGenerator/RowWriter.h"
#include "platform/encodings/PropertyList.h"
#include "platform/system/Environment.h"
#include "platform/telephony/TelephonyConstants.h"

namespace kelvo {

Value payloadPropertyList(ByteView packet) {
    Result<Value> value = readPropertyList(payloadOf(packet));
    return value ? *value : Value();
}

// Up to five sections read one record, and a phone that stays where it is sends the same array again and again: the
// last one is kept with its bytes.
Value cellInfo(ByteView packet) {
    thread_local Bytes lastPayload;
    thread_local Value lastValue;
    const ByteView payload = payloadOf(packet);
    if (!lastValue || !std::ranges::equal(payload, lastPayload)) {
        lastValue = payloadPropertyList(packet);
        lastPayload.assign(payload.begin(), payload.end());
    }
    return lastValue;
}

bool isCell(const Value& cell, std::string_view technology, std::string_view cellType) {
    static constexpr Key kTechnology(kPLCellMonitorCellRadioAccessTechnology);
    static constexpr Key kType(kPLCellMonitorCellType);
    const auto says = [&](Key key, std::string_view expected) {
        const std::string* text = (*cell.dictionary())[key].string();
        return text != nullptr && *text == expected;
    };
    return cell.dictionary() && says(kTechnology, technology) && says(kType, cellType);
}

namespace {

/// The cells of a property list, or none and two error lines.
ArrayRef cellsOf(const Value& payload) {
    if (!payload) {
        logLine(Level::Error, "Cell Info Array data could not be constructed");
        logLine(Level::Error, "Failed to get Cell Array\n");
        return nullptr;
    }
    return payload.array() ? payload.array() : Array::make();
}

const Dictionary* firstCell(const Array& cells, std::string_view technology, std::string_view cellType) {
    for (const Value& cell : cells) {
        if (isCell(cell, technology, cellType)) return cell.dictionary().get();
    }
    return nullptr;
}

/// The values of a cell, each with its field; a value that is no 32-bit integer is reported on the log instead.
template <class Show>
void eachValue(const Dictionary& cell, std::span<const CellField> fields, Show show) {
    for (const CellField& field : fields) {
        const Number* number = cell[field.cellKey].number();
        const auto value = number != nullptr ? number->int32() : std::nullopt;
        if (value) {
            show(field, *value);
        } else if (field.failure != nullptr) {
            logLine(Level::Error, field.failure);
        }
    }
}

}  // namespace

ArrayRef cellInfoArray(ByteView packet) { return cellsOf(cellInfo(packet)); }

void showCell(const DictionaryRef& shown, const Dictionary& cell, std::span<const CellField> fields) {
    eachValue(cell, fields, [&](const CellField& field, std::int32_t value) {
        if (shown) showValue(shown->slot(field.displayKey), value, field.shown);
    });
}

void showServingCell(const DictionaryRef& shown, ByteView packet, std::string_view technology,
                     std::span<const CellField> fields) {
    const ArrayRef cells = cellInfoArray(packet);
    const Dictionary* serving = cells ? firstCell(*cells, technology, kPLCellMonitorCellTypeServing) : nullptr;
    if (serving != nullptr) showCell(shown, *serving, fields);
}

void showNeighbors(const ArrayRef& list, ByteView packet, std::string_view technology,
                   std::span<const CellField> fields) {
    const Value payload = cellInfo(packet);
    if (!payload) Base::clearElementsInArray(list);  // before the error is told
    const ArrayRef cells = cellsOf(payload);
    if (!cells) return;
    RowWriter rows(list);
    for (const Value& cell : *cells) {
        if (!isCell(cell, technology, kPLCellMonitorCellTypeNeighbor)) continue;
        Dictionary::Rewrite row = rows.next();
        eachValue(*cell.dictionary(), fields, [&](const CellField& field, std::int32_t value) {
            showValue(row.next(field.displayKey), value, field.shown);
        });
    }
}

}  // namespace kelvo
