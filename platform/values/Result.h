#pragma once

#include <optional>
#include <string>
#include <utility>
#include <variant>

namespace kelvo {

/// Why something failed, in one line for a person.
struct Failure {
    std::string reason;
};

/// Either the value that was asked for or the error that prevented it: the one way in which an operation says that it
/// failed. `E` is another type only where the caller acts upon the kind of failure.
/// `value()` and `error()` may only be called on the matching kind.
template <class T, class E = Failure>
class [[nodiscard]] Result {
public:
    Result(T value) : _content(std::in_place_index<0>, std::move(value)) {}
    Result(E error) : _content(std::in_place_index<1>, std::move(error)) {}

    explicit operator bool() const { return _content.index() == 0; }
    T& value() & { return std::get<0>(_content); }
    const T& value() const& { return std::get<0>(_content); }
    T&& value() && { return std::get<0>(std::move(_content)); }
    const E& error() const { return std::get<1>(_content); }

    T& operator*() { return value(); }
    const T& operator*() const { return value(); }
    T* operator->() { return &value(); }
    const T* operator->() const { return &value(); }

private:
    std::variant<T, E> _content;
};

/// Of an operation that has nothing to give: `return {};` says that it went well.
template <class E>
class [[nodiscard]] Result<void, E> {
public:
    Result() = default;
    Result(E error) : _error(std::move(error)) {}

    explicit operator bool() const { return !_error; }
    const E& error() const { return _error.value(); }

private:
    std::optional<E> _error;
};

}  // namespace kelvo
