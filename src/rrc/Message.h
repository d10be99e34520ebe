// An RRC message, read into a flat list of its values, and views of them.
//
// A `Message` keeps its memory from one message to the next. Its views are valid until it reads again, and as long as
// the bytes that it has read.
#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <span>
#include <string_view>
#include <vector>

#include "rrc/Fault.h"
#include "rrc/Grammar.h"
#include "rrc/Path.h"
#include "rrc/Pdu.h"

namespace vespscope::rrc {

// A value with everything that it holds behind it.
struct Node {
  TypeId type = 0;
  NameId name = noName;
  bool unreadable = false;  // a byte string whose content is not what the definitions state
  std::uint32_t end = 0;    // the index of the next value that this one does not hold
  std::uint32_t bit = 0;    // where it begins; of a string, its first bit
  std::uint32_t bits = 0;   // how many it takes; of a string, without its length
  std::int64_t value = 0;   // see View::value
};

class Message;

// A value of a message, or none: a view of what is absent is false, has the value 0 and holds nothing.
class View {
 public:
  View() = default;

  explicit operator bool() const { return message_ != nullptr; }
  [[nodiscard]] Kind kind() const;
  // As the definitions spell it; empty for an element of a list.
  [[nodiscard]] std::string_view name() const;
  // Of an integer and a boolean, itself; of an enumerated and a choice, the index, counting from 0 and across the
  // extension marker; of a list, the number of elements; else 0.
  [[nodiscard]] std::int64_t value() const;
  // The name of an enumerated value; empty for one of a later release.
  [[nodiscard]] std::string_view item() const;
  [[nodiscard]] bool unreadable() const;
  // Where it begins in the message, and how many bits it takes.
  [[nodiscard]] std::size_t bit() const;
  [[nodiscard]] std::size_t bits() const;

  // The number in the name of an enumerated value, in its unit: 10 of "psf10", -3 of "dB-3"; nothing of "infinity" and
  // of spare values.
  [[nodiscard]] std::optional<int> itemNumber() const;
  [[nodiscard]] NameId id() const;
  // Of a choice, what is chosen, also through choices in choices; of anything else, itself.
  [[nodiscard]] View chosen() const;

  // What the path leads to. The content of a byte string counts as the string itself.
  [[nodiscard]] View operator[](const Path& path) const;
  // What the path leads to here, or in the first of the nested `nonCriticalExtension` where it exists.
  [[nodiscard]] View extension(const Path& path) const;
  // The value, if there is one.
  template <class Number>
  [[nodiscard]] std::optional<Number> as() const {
    if (message_ == nullptr) return std::nullopt;
    return static_cast<Number>(value());
  }

  // As `as`, of what the path leads to.
  template <class Number>
  [[nodiscard]] std::optional<Number> as(const Path& path) const {
    return (*this)[path].as<Number>();
  }

  // The first value inside this one, and the next beside this one.
  [[nodiscard]] View first() const;
  [[nodiscard]] View next() const;

  // A string of at most 57 bits as a number, the first bit the highest.
  [[nodiscard]] std::optional<std::uint64_t> number() const;
  // The bytes of a string; a last incomplete one is filled with zeros.
  [[nodiscard]] std::vector<std::uint8_t> bytes() const;

  // What this value holds: `for (View child : view)`.
  class Iterator;
  [[nodiscard]] Iterator begin() const;
  [[nodiscard]] Iterator end() const;

 private:
  friend class Message;
  View(const Message* message, std::uint32_t index, std::uint32_t limit)
      : message_(message), index_(index), limit_(limit) {}
  [[nodiscard]] const Node& node() const;
  [[nodiscard]] View child(NameId name) const;

  const Message* message_ = nullptr;
  std::uint32_t index_ = 0;
  std::uint32_t limit_ = 0;  // the end of the value that holds this one
};

// `one`, if there is one, else `other`.
[[nodiscard]] inline View either(const View& one, const View& other) { return one ? one : other; }

// The number in the name of an enumerated value or an alternative: 2560 of "sf2560", 0 of "psf0-v1020", nothing of
// "spare3".
[[nodiscard]] std::optional<int> numberIn(std::string_view name);

class View::Iterator {
 public:
  explicit Iterator(View view) : view_(view) {}
  View operator*() const { return view_; }
  Iterator& operator++() {
    view_ = view_.next();
    return *this;
  }
  bool operator!=(const Iterator& other) const { return view_.message_ != other.view_.message_; }

 private:
  View view_;
};

class Message {
 public:
  // Reads a whole message. Bytes behind it are left alone: channels fill up with padding. After a fault the message is
  // empty.
  [[nodiscard]] std::optional<Fault> read(Pdu pdu, std::span<const std::uint8_t> bytes);

  // The whole message; absent when nothing has been read.
  [[nodiscard]] View root() const;
  // What was asked to be read last.
  [[nodiscard]] Pdu pdu() const { return pdu_; }
  // The message that the channel's envelope holds, such as "rrcConnectionRelease" or "mib"; for what has no envelope,
  // the root.
  [[nodiscard]] View body() const;
  // The information elements of the body: those of the release that its sender has chosen, such as
  // "rrcConnectionRelease-r8", or the body itself when its definition offers no choice.
  [[nodiscard]] View content() const;
  // All values in the order of the message, each before what it holds.
  [[nodiscard]] std::span<const Node> nodes() const { return nodes_; }
  [[nodiscard]] std::span<const std::uint8_t> bytes() const { return bytes_; }

 private:
  Pdu pdu_{};
  std::vector<Node> nodes_;
  std::span<const std::uint8_t> bytes_;
};

inline View::Iterator View::begin() const { return Iterator(first()); }
inline View::Iterator View::end() const { return Iterator(View()); }

}  // namespace vespscope::rrc
