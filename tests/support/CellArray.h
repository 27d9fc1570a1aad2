#pragma once

#include <initializer_list>
#include <string>
#include <string_view>
#include <utility>

#include "platform/encodings/PropertyList.h"
#include "platform/values/Bytes.h"
#include "tests/support/Record.h"

namespace kelvo::test {

/// A record whose payload is `content` as an XML property list.
inline Record payload(LogCode code, const Value& content) {
    return Record(code, 13).text(13, textOf(*writeXmlPropertyList(content)));
}

/// A cell-information record.
inline Record cellArray(std::initializer_list<Value> cells) { return payload(0xff0001, Array::make(cells)); }

/// One cell of it: "GSM", "UMTS", …, "Serving" or "Neighbor", and what else it says.
inline Value cell(const std::string& technology, const std::string& type,
                  std::initializer_list<std::pair<std::string_view, Value>> more = {}) {
    const DictionaryRef cell = Dictionary::make(more);
    cell->set("kPLCellMonitorCellRadioAccessTechnology", "kPLCellMonitorRadioAccessTechnology" + technology);
    cell->set("kPLCellMonitorCellType", "kPLCellMonitorCellType" + type);
    return cell;
}

}  // namespace kelvo::test
