#pragma once

#include <string>
#include <utility>
#include <variant>

namespace quarn {

/// Why an operation failed, in one sentence that a person can act on: what failed, on which file or
/// object, why, and what to try. UTF-8, no line break at the end.
struct Error {
    std::string message;
};

/// A value of type T, or the Error that kept it from being made.
template <class T> class [[nodiscard]] Result {
public:
    Result(T value) : m_state(std::in_place_index<0>, std::move(value)) {}
    Result(Error error) : m_state(std::in_place_index<1>, std::move(error)) {}

    bool ok() const { return m_state.index() == 0; }
    explicit operator bool() const { return ok(); }

    /// The value; only when ok().
    T& value() { return *std::get_if<0>(&m_state); }
    const T& value() const { return *std::get_if<0>(&m_state); }

    /// The message of the failure; only when not ok().
    const std::string& message() const { return std::get_if<1>(&m_state)->message; }
    Error error() const { return *std::get_if<1>(&m_state); }

private:
    std::variant<T, Error> m_state;
};

/// The result of an operation that makes nothing: success, or an Error.
template <> class [[nodiscard]] Result<void> {
public:
    Result() = default;
    Result(Error error) : m_error(std::move(error)), m_ok(false) {}

    bool ok() const { return m_ok; }
    explicit operator bool() const { return ok(); }
    const std::string& message() const { return m_error.message; }
    Error error() const { return m_error; }

private:
    Error m_error;
    bool m_ok = true;
};

} // namespace quarn
