#pragma once

#include <string>
#include <vector>

#include "LogGenerator/Base.h"
#include "platform/system/Environment.h"
#include "tests/support/Record.h"
#include "tests/support/RecordingLog.h"

namespace kelvo::test {

/// A section bound to a display part of its own, fed with records; what it shows and logs can be read back.
template <class SectionClass>
class Fed {
public:
    /// A section over a dictionary of values.
    Fed() : Fed(Value(Dictionary::make())) {}
    /// A section over `part`, for example Array::make() for a list section.
    explicit Fed(Value part) : _part(std::move(part)) {
        _section.updateSectionRef(_part);
        _log.clear();
    }
    explicit Fed(const Record& record) : Fed() { feed(record); }

    Fed& feed(const Record& record) { return feed(record.bytes(), record.code()); }
    Fed& feed(const Bytes& bytes, LogCode code) {
        const Environment::Scope environment({.log = &_log});
        _section.updateWithData(ByteView(bytes), code);
        return *this;
    }

    /// The value shown under `key`; "(absent)" when there is none, "(no text)" when it is no string.
    std::string operator[](const std::string& key) const { return textOf(*_part.dictionary(), key); }
    /// The value shown under `key` in row `index` of a list section.
    std::string row(std::size_t index, const std::string& key) const {
        const ArrayRef& rows = _part.array();
        return index < rows->size() ? textOf(*(*rows)[index].dictionary(), key) : "(no row)";
    }
    std::size_t rowCount() const { return _part.array()->size(); }
    const Value& part() const { return _part; }

    const std::vector<RecordingLog::Line>& log() const { return _log.lines(); }
    void clearLog() { _log.clear(); }
    SectionClass& section() { return _section; }

private:
    static std::string textOf(const Dictionary& values, const std::string& key) {
        const Value* value = values.find(key);
        if (value == nullptr) return "(absent)";
        return value->string() != nullptr ? *value->string() : "(no text)";
    }

    ClassDictionary _classDict;
    CodeDictionary _codeDict;
    SectionClass _section{_classDict, _codeDict};
    Value _part;
    RecordingLog _log;
};

}  // namespace kelvo::test
