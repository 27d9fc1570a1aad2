#include "platform/encodings/BinaryPropertyListReader.h"

#include <fmt/format.h>

#include <algorithm>
#include <bit>
#include <cmath>
#include <limits>
#include <string>
#include <vector>

#include "platform/encodings/IsoDate.h"
#include "platform/encodings/PropertyList.h"
#include "platform/encodings/Utf8.h"

namespace kelvo {

namespace {

constexpr std::size_t kHeaderSize = 8;
constexpr std::size_t kTrailerSize = 32;

// What references to shared objects may add to a document's own size: enough for one that shares every key and text,
// and far from what a small message would need to exhaust the memory.
constexpr std::size_t kSpareObjects = 65'536;
constexpr std::size_t kSpareBytes = std::size_t{1} << 20;
constexpr std::size_t kSpareFactor = 64;  // bytes for each of a document's own
constexpr std::size_t kMostSpareBytes = std::size_t{64} << 20;

class BinaryReader {
public:
    explicit BinaryReader(ByteView data) : _data(data) {}

    Result<Value> read() {
        Value value;
        if (!readTrailer() || !readObject(_root, 1, value)) return Failure{std::move(_reason)};
        return value;
    }

private:
    /// A marker with its size read: where the object's bytes start and how many units they are.
    struct Object {
        std::size_t at;     // of the marker
        unsigned kind;      // the marker's high half
        std::size_t count;  // the marker's low half, or the number that follows when that is 15
        std::size_t start;  // of the bytes behind marker and count
    };

    bool readTrailer() {
        if (_data.size() < kHeaderSize + kTrailerSize) return fail("binary property list cut short", _data.size());
        if (textOf(_data.first(kHeaderSize)) != "bplist00") return fail("unknown version of binary property list", 0);
        const std::size_t trailer = _data.size() - kTrailerSize;
        _offsetSize = _data[trailer + 6];
        _referenceSize = _data[trailer + 7];
        const std::uint64_t count = bigEndian(trailer + 8, 8);
        const std::uint64_t root = bigEndian(trailer + 16, 8);
        const std::uint64_t table = bigEndian(trailer + 24, 8);
        if (_offsetSize < 1 || _offsetSize > 8 || _referenceSize < 1 || _referenceSize > 8) {
            return fail("impossible integer sizes in the trailer", trailer + 6);
        }
        if (table <= kHeaderSize || table >= trailer) return fail("offset table outside the document", trailer + 24);
        if (count != (trailer - table) / _offsetSize || (trailer - table) % _offsetSize != 0) {
            return fail("number of objects that does not match the offset table", trailer + 8);
        }
        if (root >= count) return fail("root object out of range", trailer + 16);
        _table = table;
        _root = root;
        _count = count;
        _open.resize(count);
        _objectsLeft = _data.size() + kSpareObjects;
        _bytesLeft = _data.size() + std::min(kMostSpareBytes, kSpareBytes + kSpareFactor * _data.size());
        return true;
    }

    /// Finds object `index`, which is below the count, and reads its marker.
    bool openObject(std::size_t index, Object& out) {
        const std::size_t entry = _table + index * _offsetSize;
        const std::uint64_t at = bigEndian(entry, _offsetSize);
        if (at < kHeaderSize || at >= _table) return fail("object offset outside the document", entry);
        const unsigned marker = _data[at];
        out = {at, marker >> 4U, marker & 0xFU, at + 1};
        return out.kind < 0x4 || out.count != 0xF || readCount(out);
    }

    /// A count of 15 stands for an integer object behind the marker.
    bool readCount(Object& object) {
        const std::size_t size = object.start < _table ? std::size_t{1} << (_data[object.start] & 0xFU) : 0;
        if (size == 0 || _data[object.start] >> 4U != 0x1 || size > 8 || size > _table - object.start - 1) {
            return fail("object without a valid count", object.at);
        }
        const std::uint64_t count = bigEndian(object.start + 1, size);
        if (count > _data.size()) return fail("object that reaches past the end", object.at);
        object.count = count;
        object.start += 1 + size;
        return true;
    }

    bool readObject(std::size_t index, int depth, Value& out) {
        if (depth > kMaxPropertyListDepth) {
            return fail(fmt::format("nested deeper than {} levels", kMaxPropertyListDepth),
                        _table + index * _offsetSize);
        }
        Object object{};
        if (!openObject(index, object)) return false;
        switch (object.kind) {
            case 0x0: return readSingleton(object, out);
            case 0x1: return readInteger(object, out);
            case 0x2: return readReal(object, out);
            case 0x3: return readDate(object, out);
            case 0x4: return readData(object, out);
            case 0x5:
            case 0x6: return readString(object, out.text());
            case 0xA:
            case 0xD: return readContainer(index, object, depth, out);
            case 0x8: return fail("UID, which has no place in a property list", object.at);
            case 0xB:
            case 0xC: return fail("set, which has no place in a property list", object.at);
            default: return failUnknown(object);
        }
    }

    bool readSingleton(const Object& object, Value& out) {
        if (object.count != 0x8 && object.count != 0x9) return failUnknown(object);
        out = object.count == 0x9;
        return true;
    }

    /// Below 8 bytes an integer is unsigned, from there on it is signed; 16 bytes must extend the sign of the last 8.
    bool readInteger(const Object& object, Value& out) {
        const std::size_t size = std::size_t{1} << object.count;
        if (size > 16) return failUnknown(object);
        if (!fits(object, size)) return false;
        const std::size_t low = size == 16 ? object.start + 8 : object.start;
        const auto value = static_cast<std::int64_t>(bigEndian(low, size == 16 ? 8 : size));
        if (size == 16 && static_cast<std::int64_t>(bigEndian(object.start, 8)) != (value < 0 ? -1 : 0)) {
            return fail("integer beyond 64 bits", object.at);
        }
        out = value;
        return true;
    }

    bool readReal(const Object& object, Value& out) {
        if (object.count != 2 && object.count != 3) return failUnknown(object);
        const std::size_t size = std::size_t{1} << object.count;
        if (!fits(object, size)) return false;
        out = real(object.start, size);
        return true;
    }

    /// Seconds since 2001-01-01 00:00 UTC as a real of 8 bytes.
    bool readDate(const Object& object, Value& out) {
        constexpr double kEpoch = 978307200;  // in seconds since 1970
        constexpr double kFarthest = 1e12;    // seconds; well beyond the year 9999, and safe to convert
        if (object.count != 3) return failUnknown(object);
        if (!fits(object, 8)) return false;
        const double seconds = real(object.start, 8);
        if (!(std::abs(seconds) < kFarthest)) return fail("date outside the years 0 to 9999", object.at);
        const Date date(std::chrono::milliseconds(std::llround((seconds + kEpoch) * 1000)));
        if (!hasIsoForm(date)) return fail("date outside the years 0 to 9999", object.at);
        out = date;
        return true;
    }

    bool readData(const Object& object, Value& out) {
        if (!fits(object, object.count) || !spend(_bytesLeft, object.count, object)) return false;
        const ByteView bytes = _data.subspan(object.start, object.count);
        out = Bytes(bytes.begin(), bytes.end());
        return true;
    }

    /// ASCII, taken as UTF-8 because some writers put that there, or UTF-16.
    bool readString(const Object& object, std::string& out) {
        const std::size_t size = object.kind == 0x6 ? 2 * object.count : object.count;
        if (!fits(object, size) || !spend(_bytesLeft, size, object)) return false;
        const ByteView bytes = _data.subspan(object.start, size);
        out.clear();
        if (object.kind == 0x6) {
            out = utf8FromUtf16(bytes, std::endian::big);
        } else {
            appendCleanUtf8(out, textOf(bytes));
        }
        return true;
    }

    bool readContainer(std::size_t index, const Object& object, int depth, Value& out) {
        const std::size_t references = object.kind == 0xD ? 2 * object.count : object.count;
        if (references > (_table - object.start) / _referenceSize) return failCut(object);
        if (!spend(_objectsLeft, references, object)) return false;
        if (_open[index]) return fail("object that contains itself", object.at);
        _open[index] = true;
        const bool good = object.kind == 0xD ? readDictionary(object, depth, out) : readArray(object, depth, out);
        _open[index] = false;
        return good;
    }

    bool readArray(const Object& object, int depth, Value& out) {
        std::vector<Value> elements(object.count);
        for (std::size_t i = 0; i < object.count; ++i) {
            std::size_t element = 0;
            if (!readReference(object, i, element) || !readObject(element, depth + 1, elements[i])) return false;
        }
        out = std::make_shared<Array>(std::move(elements));
        return true;
    }

    /// First the references to all keys, then those to their values.
    bool readDictionary(const Object& object, int depth, Value& out) {
        auto dictionary = std::make_shared<Dictionary>();
        dictionary->reserve(object.count);
        for (std::size_t i = 0; i < object.count; ++i) {
            std::size_t value = 0;
            std::string_view key;
            if (!readKey(object, i, key) || !readReference(object, object.count + i, value)) return false;
            if (!readObject(value, depth + 1, dictionary->slot(key))) return false;
        }
        out = std::move(dictionary);
        return true;
    }

    /// The key is read where it stands when it is ASCII; it is valid until the next one.
    bool readKey(const Object& dictionary, std::size_t i, std::string_view& out) {
        std::size_t index = 0;
        Object key{};
        if (!readReference(dictionary, i, index) || !openObject(index, key)) return false;
        if (key.kind != 0x5 && key.kind != 0x6) return fail("key that is not a string", key.at);
        if (key.kind == 0x5 && fits(key, key.count)) {
            out = textOf(_data.subspan(key.start, key.count));
            if (isAscii(out)) return spend(_bytesLeft, key.count, key);
        }
        if (!readString(key, _key)) return false;
        out = _key;
        return true;
    }

    /// Reference `i` of a container whose references are known to lie inside the document.
    bool readReference(const Object& container, std::size_t i, std::size_t& out) {
        const std::size_t at = container.start + i * _referenceSize;
        const std::uint64_t index = bigEndian(at, _referenceSize);
        if (index >= _count) return fail("reference to an object that does not exist", at);
        out = index;
        return true;
    }

    bool fits(const Object& object, std::size_t size) { return size <= _table - object.start || failCut(object); }

    bool spend(std::size_t& left, std::size_t amount, const Object& object) {
        if (amount > left) return fail("shared objects that multiply beyond measure", object.at);
        left -= amount;
        return true;
    }

    double real(std::size_t at, std::size_t size) const {
        const std::uint64_t bits = bigEndian(at, size);
        if (size == 4) return std::bit_cast<float>(static_cast<std::uint32_t>(bits));
        return std::bit_cast<double>(bits);
    }

    std::uint64_t bigEndian(std::size_t at, std::size_t size) const {
        std::uint64_t value = 0;
        for (std::size_t i = 0; i < size; ++i) value = value << 8U | _data[at + i];
        return value;
    }

    bool failUnknown(const Object& object) {
        return fail(fmt::format("unknown object type 0x{:02x}", _data[object.at]), object.at);
    }

    bool failCut(const Object& object) { return fail("object that reaches past the end", object.at); }

    bool fail(std::string_view what, std::size_t at) {
        _reason = fmt::format("{} at offset {}", what, at);
        return false;
    }

    ByteView _data;
    std::size_t _offsetSize = 0;
    std::size_t _referenceSize = 0;
    std::size_t _table = 0;  // where the offset table starts, which is where the objects end
    std::size_t _root = 0;
    std::size_t _count = 0;
    std::size_t _objectsLeft = 0;
    std::size_t _bytesLeft = 0;
    std::vector<bool> _open;  // containers that are being read
    std::string _key;
    std::string _reason;
};

}  // namespace

bool isBinaryPropertyList(std::string_view data) { return data.starts_with("bplist"); }

Result<Value> readBinaryPropertyList(ByteView data) { return BinaryReader(data).read(); }

}  // namespace kelvo
