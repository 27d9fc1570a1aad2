#pragma once

#include <chrono>
#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <variant>

#include "platform/values/Bytes.h"

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

/// A text that nobody has read yet, so that it need not be written: what `print` makes of `raw`, as `how` says. `how`
/// is static data; it outlives every value.
struct UnwrittenText {
    using Print = void (*)(std::string& text, std::int64_t raw, const void* how);

    std::int64_t raw;
    const void* how;
    Print print;
};

/// One property-list value: none, or one of the seven kinds.
/// Strings, numbers, booleans, data and dates are values. Arrays and dictionaries are shared objects with identity:
/// copying the Value shares them, `copy()` makes new ones all the way down.
///
/// A display changes far more often than it is read. A string may therefore wait as an UnwrittenText; the first look at
/// it writes it, which makes reading a value a matter for the thread that owns it.
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

    Kind kind() const { return _content.index() != kUnwritten ? static_cast<Kind>(_content.index()) : Kind::String; }
    explicit operator bool() const { return kind() != Kind::None; }

    // Access by kind: null (or none) when the value is of another kind.
    // A text stands where it is until the value is written.
    const std::string* string() const {
        if (_content.index() == kUnwritten) write();
        return std::get_if<std::string>(&_content);
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

    /// Makes the value a string, whatever it was, and hands out its text for writing. A value that is a string already
    /// keeps its storage, so that writing a text of similar length does not allocate.
    std::string& text();

    /// Makes the value a string, whatever it was, whose text is written when somebody asks for it.
    void set(const UnwrittenText& text) {
        if (auto* waiting = std::get_if<UnwrittenText>(&_content)) {
            *waiting = text;
        } else {
            _content = text;
        }
    }

    /// A deep copy: new arrays and dictionaries all the way down. Data is immutable and stays shared.
    Value copy() const;

    /// Deep comparison; dictionaries compare as sets of entries, without their order.
    friend bool operator==(const Value& a, const Value& b);

private:
    static constexpr std::size_t kUnwritten = 8;  // index of UnwrittenText, behind those of the kinds

    static const ArrayRef kNoArray;
    static const DictionaryRef kNoDictionary;

    void write() const;

    mutable std::variant<std::monostate, std::string, kelvo::Number, bool, std::shared_ptr<const Bytes>, kelvo::Date,
                         ArrayRef, DictionaryRef, UnwrittenText>
        _content;  // changes under a reader when an unwritten text is written
};

/// The kind's name for messages: "string", "dictionary", …
std::string_view kindName(Value::Kind kind);

}  // namespace kelvo

#include "platform/values/Array.h"
#include "platform/values/Dictionary.h"
