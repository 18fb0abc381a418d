// The outcome of an operation that can fail: a value, or an error that a person can act on.
#pragma once

#include <optional>
#include <string>
#include <utility>
#include <variant>

namespace plume {

struct Error {
    // One sentence: what is wrong, where (file, line or path in the data) and what was expected.
    std::string message;

    bool operator==(const Error&) const = default;
};

template <typename Value>
class [[nodiscard]] Result {
  public:
    Result(Value value) : content_(std::in_place_index<0>, std::move(value)) {}
    Result(Error error) : content_(std::in_place_index<1>, std::move(error)) {}

    bool ok() const { return content_.index() == 0; }
    explicit operator bool() const { return ok(); }

    // Only when ok().
    Value& value() & { return std::get<0>(content_); }
    const Value& value() const& { return std::get<0>(content_); }
    Value&& value() && { return std::get<0>(std::move(content_)); }
    // Only when not ok().
    const Error& error() const { return std::get<1>(content_); }

  private:
    std::variant<Value, Error> content_;
};

template <>
class [[nodiscard]] Result<void> {
  public:
    Result() = default;
    Result(Error error) : error_(std::move(error)) {}

    bool ok() const { return !error_.has_value(); }
    explicit operator bool() const { return ok(); }
    const Error& error() const { return *error_; }

  private:
    std::optional<Error> error_;
};

}  // namespace plume
