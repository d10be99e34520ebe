// A value or the reason why there is none.
#pragma once

#include <string>
#include <utility>
#include <variant>

namespace vespscope {

template <class Reason>
struct Failure {
  Reason reason;
};
template <class Reason>
Failure(Reason) -> Failure<Reason>;

// Holds a `Value`, or a `Reason` given as `Failure{reason}`.
template <class Value, class Reason = std::string>
class [[nodiscard]] Result {
 public:
  Result(Value value) : data_(std::in_place_index<0>, std::move(value)) {}
  template <class Given>
  Result(Failure<Given> failure) : data_(std::in_place_index<1>, std::move(failure.reason)) {}

  [[nodiscard]] bool ok() const { return data_.index() == 0; }
  explicit operator bool() const { return ok(); }
  // Only when ok().
  [[nodiscard]] Value& value() { return std::get<0>(data_); }
  [[nodiscard]] const Value& value() const { return std::get<0>(data_); }
  Value& operator*() { return value(); }
  const Value& operator*() const { return value(); }
  Value* operator->() { return &value(); }
  const Value* operator->() const { return &value(); }
  // Only when not ok().
  [[nodiscard]] const Reason& reason() const { return std::get<1>(data_); }

 private:
  std::variant<Value, Reason> data_;
};

}  // namespace vespscope
