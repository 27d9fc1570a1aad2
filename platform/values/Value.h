#pragma once

#include <chrono>
#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <variant>

#include "platform/values/Bytes.h"
#include "platform/values/Reading.h"

namespace kelvo {

class Array;
class Dictionary;
using ArrayRef = std::shared_ptr<Array>;
using DictionaryRef = std::shared_ptr<Dictionary>;

/// A property-list number: an integer of 64 bits, or a real.
class Number {
public:
    Number(std::int64_t integer) : _value(integer) {}
    Number(double real) : _value(real) {}

    bool isReal() const { return _value.index() == 1; }
    /// The value as it is stored or converted; a real beyond the integer's range gives the nearest end, NaN gives 0.
    std::int64_t integer() const;
    double real() const;
    /// The value when 32 signed bits hold it exactly; none otherwise (a fraction, a larger magnitude).
    std::optional<std::int32_t> int32() const;
    friend bool operator==(const Number&, const Number&) = default;

private:
    std::variant<std::int64_t, double> _value;
};

/// A property-list date; milliseconds since 1970-01-01 00:00 UTC.
using Date = std::chrono::sys_time<std::chrono::milliseconds>;

/// One property-list value: none, or one of the seven kinds.
/// Strings, numbers, booleans, data and dates are values. Arrays and dictionaries are shared objects with identity:
/// copying the Value shares them, `copy()` makes new ones all the way down.
///
/// A string may be a Reading: the raw number of a record stands beside its text. A display changes far more often than
/// it is read, so the first look at such a string prints it, which makes reading a value a matter for the thread that
/// owns it.
///
/// A value knows the number of the record that wrote it last. Copies keep it; what is saved holds the texts alone.
class Value {
public:
    enum class Kind { None, String, Number, Boolean, Data, Date, Array, Dictionary };

    Value() = default;
    Value(std::string text) : _content(std::move(text)) {}
    Value(std::string_view text) : _content(std::string(text)) {}
    Value(const char* text) : _content(std::string(text)) {}
    Value(kelvo::Number number) : _content(number) {}
    Value(int number) : _content(kelvo::Number(std::int64_t{number})) {}
    Value(std::int64_t number) : _content(kelvo::Number(number)) {}
    Value(double number) : _content(kelvo::Number(number)) {}
    Value(bool boolean) : _content(boolean) {}
    Value(Bytes data) : _content(std::make_shared<const Bytes>(std::move(data))) {}
    Value(kelvo::Date date) : _content(date) {}
    Value(ArrayRef array);            ///< a null reference gives none
    Value(DictionaryRef dictionary);  ///< a null reference gives none
    template <class T>
    Value(T*) = delete;  // keeps a stray pointer from becoming a boolean

    Kind kind() const { return _content.index() != kReading ? static_cast<Kind>(_content.index()) : Kind::String; }
    explicit operator bool() const { return kind() != Kind::None; }

    // Access by kind: null (or none) when the value is of another kind.
    // A text stands where it is until the value is written.
    const std::string* string() const {
        const auto* shown = std::get_if<ShownReading>(&_content);
        return shown != nullptr ? &shown->printed() : std::get_if<std::string>(&_content);
    }
    const kelvo::Number* number() const { return std::get_if<kelvo::Number>(&_content); }
    const bool* boolean() const { return std::get_if<bool>(&_content); }
    const Bytes* data() const;
    const kelvo::Date* date() const { return std::get_if<kelvo::Date>(&_content); }
    const ArrayRef& array() const {
        const auto* array = std::get_if<ArrayRef>(&_content);
        return array != nullptr ? *array : kNoArray;
    }
    const DictionaryRef& dictionary() const {
        const auto* dictionary = std::get_if<DictionaryRef>(&_content);
        return dictionary != nullptr ? *dictionary : kNoDictionary;
    }

    /// The number of the record that wrote the value last; 0 for a value that none has written.
    std::uint64_t record() const { return _record; }
    /// Says who has written the value. A text that is written anew through `text()` keeps the number before.
    void setRecord(std::uint64_t number) { _record = number; }

    /// What a record reported here last; null for a value that no record's number stands behind.
    const Reading* reading() const {
        const auto* shown = std::get_if<ShownReading>(&_content);
        return shown != nullptr ? &shown->reading() : nullptr;
    }
    /// The reading's number in its unit; none without a reading, and for one that is no number.
    std::optional<Measurement> measurement() const;

    /// Makes the value a string, whatever it was, and hands out its text for writing. A value that is a string already
    /// keeps its storage, so that writing a text of similar length does not allocate.
    std::string& text();

    /// Makes the value a string, whatever it was: the text of a reading of the record with the number `record`.
    void set(const Reading& reading, std::uint64_t record = 0) {
        _record = record;
        if (auto* shown = std::get_if<ShownReading>(&_content)) {
            shown->set(reading);
        } else {
            _content.emplace<ShownReading>(reading);
        }
    }

    /// A deep copy: new arrays and dictionaries all the way down. Data is immutable and stays shared.
    Value copy() const;

    /// Deep comparison of what is shown, whoever wrote it; dictionaries compare as sets of entries, without their
    /// order.
    friend bool operator==(const Value& a, const Value& b);

private:
    /// A reading and its text, which is none or empty until it is printed. The text lies outside, so that a reading
    /// makes no other value larger; a copy prints its own.
    class ShownReading {
    public:
        explicit ShownReading(const Reading& reading) : _reading(reading) {}
        ShownReading(const ShownReading& other) noexcept : _reading(other._reading) {}
        ShownReading& operator=(const ShownReading& other) noexcept {
            set(other._reading);
            return *this;
        }
        ~ShownReading() = default;

        const Reading& reading() const { return _reading; }
        void set(const Reading& reading) {
            _reading = reading;
            if (_text) _text->clear();
        }
        const std::string& printed() const {
            if (!_text) _text = std::make_unique<std::string>();
            if (_text->empty()) _reading.quantity->print(*_text, _reading.raw);
            return *_text;
        }

    private:
        Reading _reading;
        mutable std::unique_ptr<std::string> _text;
    };

    static constexpr std::size_t kReading = 8;  // index of ShownReading, behind those of the kinds

    static const ArrayRef kNoArray;
    static const DictionaryRef kNoDictionary;

    std::variant<std::monostate, std::string, kelvo::Number, bool, std::shared_ptr<const Bytes>, kelvo::Date, ArrayRef,
                 DictionaryRef, ShownReading>
        _content;
    std::uint64_t _record = 0;
};

/// The kind's name for messages: "string", "dictionary", …
std::string_view kindName(Value::Kind kind);

}  // namespace kelvo

#include "platform/values/Array.h"
#include "platform/values/Dictionary.h"
