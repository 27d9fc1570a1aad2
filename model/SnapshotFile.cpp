#include "model/SnapshotFile.h"

#include <fmt/format.h>

#include "LogGenerator/SnapshotFormat.h"
#include "platform/encodings/PropertyList.h"

namespace kelvo {

namespace {

/// Reads values out of one dictionary and notes what is of another kind than it should be.
class Reader {
public:
    Reader(std::string where, const Dictionary& dictionary, std::vector<std::string>& odd)
        : _where(std::move(where)), _dictionary(dictionary), _odd(odd) {}

    std::optional<std::string> string(std::string_view key) const {
        const Value& value = ofKind(key, Value::Kind::String);
        return value ? std::optional(*value.string()) : std::nullopt;
    }
    const Value& ofKind(std::string_view key, Value::Kind kind) const {
        static const Value kNone;
        const Value& value = _dictionary[key];
        if (!value || value.kind() == kind) return value;
        _odd.push_back(
            fmt::format("{} has a {} as \"{}\", not a {}", _where, kindName(value.kind()), key, kindName(kind)));
        return kNone;
    }

private:
    std::string _where;
    const Dictionary& _dictionary;
    std::vector<std::string>& _odd;
};

SnapshotFile::Entry entryFrom(const Value& value, std::size_t number, std::vector<std::string>& odd) {
    const std::string where = fmt::format("entry {}", number);
    if (!value.dictionary()) {
        odd.push_back(fmt::format("{} is a {}, not a dictionary", where, kindName(value.kind())));
        return {};
    }
    const Dictionary& dictionary = *value.dictionary();
    const Reader reader(where, dictionary, odd);
    return {reader.string(snapshot::kDescription), reader.string(snapshot::kDate), dictionary[snapshot::kDisplayState],
            dictionary[snapshot::kDisplay], reader.ofKind(snapshot::kDLF, Value::Kind::Data)};
}

}  // namespace

Result<SnapshotFile> SnapshotFile::read(const std::string& name, ByteView bytes) {
    if (bytes.empty()) return Failure{name + " is empty"};
    const Result<Value> tree = readPropertyList(bytes);
    if (!tree) return Failure{name + " is not a snapshot: " + tree.error().reason};
    const DictionaryRef& dictionary = tree->dictionary();
    if (!dictionary) return Failure{fmt::format("{} is not a snapshot: it holds a {}", name, kindName(tree->kind()))};
    if (!(*dictionary)[snapshot::kTimestamp] && !(*dictionary)[snapshot::kData]) {
        return Failure{fmt::format("{} is not a snapshot: it has neither \"{}\" nor \"{}\"", name, snapshot::kTimestamp,
                                   snapshot::kData)};
    }

    SnapshotFile file;
    const Reader reader("the snapshot", *dictionary, file.odd);
    file.timestamp = reader.string(snapshot::kTimestamp);
    file.description = reader.string(snapshot::kDescription);
    if (const ArrayRef& data = reader.ofKind(snapshot::kData, Value::Kind::Array).array()) {
        for (const Value& entry : *data) file.entries.push_back(entryFrom(entry, file.entries.size() + 1, file.odd));
    }
    return file;
}

}  // namespace kelvo
