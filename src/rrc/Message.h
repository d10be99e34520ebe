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
  Kind kind = Kind::unknown;  // of the type
  bool unreadable = false;    // a byte string whose content is not what the definitions state
  std::uint32_t end = 0;      // the index of the next value that this one does not hold
  std::uint32_t bit = 0;      // where it begins; of a string, its first bit
  std::uint32_t bits = 0;     // how many it takes; of a string, without its length
  std::int64_t value = 0;     // see View::value
};

class Message;

// A value of a message, or none: a view of what is absent is false, has the value 0 and holds nothing.
class View {
 public:
  View() = default;

  explicit operator bool() const { return message_ != nullptr; }
  [[nodiscard]] Kind kind() const { return node().kind; }
  // As the definitions spell it; empty for an element of a list.
  [[nodiscard]] std::string_view name() const { return nameOf(id()); }
  // Of an integer and a boolean, itself; of an enumerated and a choice, the index, counting from 0 and across the
  // extension marker; of a list, the number of elements; else 0.
  [[nodiscard]] std::int64_t value() const { return node().value; }
  // The name of an enumerated value; empty for one of a later release.
  [[nodiscard]] std::string_view item() const;
  [[nodiscard]] bool unreadable() const { return node().unreadable; }
  // Where it begins in the message, and how many bits it takes.
  [[nodiscard]] std::size_t bit() const { return node().bit; }
  [[nodiscard]] std::size_t bits() const { return node().bits; }

  // The number in the name of an enumerated value, in its unit: 10 of "psf10", -3 of "dB-3"; nothing of "infinity" and
  // of spare values.
  [[nodiscard]] std::optional<int> itemNumber() const;
  [[nodiscard]] NameId id() const { return node().name; }
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

  // What the first path leads to, if there is one, else what the second leads to.
  [[nodiscard]] View either(const Path& one, const Path& other) const {
    const View found = (*this)[one];
    return found ? found : (*this)[other];
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
  [[nodiscard]] std::span<const Node> nodes() const { return {nodes_.data(), count_}; }
  [[nodiscard]] std::span<const std::uint8_t> bytes() const { return bytes_; }

 private:
  Pdu pdu_{};
  friend class View;
  std::vector<Node> nodes_;  // the memory; `count_` of them are those of the message
  std::size_t count_ = 0;
  std::span<const std::uint8_t> bytes_;
};

inline constexpr Node absentNode{};

inline const Node& View::node() const { return message_ == nullptr ? absentNode : message_->nodes_[index_]; }

inline View View::first() const {
  const std::uint32_t end = node().end;
  return message_ == nullptr || index_ + 1 == end ? View() : View(message_, index_ + 1, end);
}

inline View View::next() const {
  const std::uint32_t end = node().end;
  return message_ == nullptr || end == limit_ ? View() : View(message_, end, limit_);
}

inline View View::chosen() const {
  View view = *this;
  while (view.kind() == Kind::choice) view = view.first();
  return view;
}

inline View View::child(NameId name) const {
  if (message_ == nullptr) return {};
  const Node* nodes = message_->nodes_.data();
  // What a byte string holds is its one child, which has no name.
  std::uint32_t from = index_;
  while (nodes[from].kind == Kind::octetString && nodes[from].end > from + 1) ++from;
  const std::uint32_t end = nodes[from].end;
  for (std::uint32_t index = from + 1; index < end; index = nodes[index].end) {
    if (nodes[index].name == name) return {message_, index, end};
  }
  return {};
}

inline View View::operator[](const Path& path) const {
  View view = *this;
  for (const NameId name : path) view = view.child(name);
  return view;
}

inline View Message::root() const { return count_ == 0 ? View() : View(this, 0, nodes_[0].end); }

inline View::Iterator View::begin() const { return Iterator(first()); }
inline View::Iterator View::end() const { return Iterator(View()); }

}  // namespace vespscope::rrc
