// Shared by the message tests: bytes in hexadecimal, messages read from them, checks of one field.
#pragma once

#include <cstdint>
#include <memory>
#include <string_view>
#include <vector>

#include <gtest/gtest.h>

#include "messages/WireMessage.h"
#include "messages/WireReader.h"
#include "values/Text.h"
#include "values/Value.h"

namespace vespscope::test {

// The bytes written as "08 96 01"; blanks are ignored.
inline Bytes hex(std::string_view digits) {
  Bytes bytes;
  int high = -1;
  for (const char digit : digits) {
    if (digit == ' ') continue;
    const int value = digit <= '9' ? digit - '0' : digit - 'a' + 10;
    if (high < 0) {
      high = value;
    } else {
      bytes.push_back(static_cast<std::uint8_t>(high << 4 | value));
      high = -1;
    }
  }
  return bytes;
}

template <class Message>
std::shared_ptr<Message> readFrom(std::string_view digits) {
  const Bytes bytes = hex(digits);
  bool decoded = false;
  auto message = Message::initWithData(bytes, &decoded);
  EXPECT_TRUE(decoded) << digits;
  return message;
}

template <class Message>
std::vector<std::shared_ptr<Message>> readAll(std::initializer_list<std::string_view> encodings) {
  std::vector<std::shared_ptr<Message>> messages;
  for (const std::string_view digits : encodings) messages.push_back(readFrom<Message>(digits));
  return messages;
}

inline std::string textOf(const WireMessage& message) { return toText(message.dictionaryRepresentation()); }

}  // namespace vespscope::test

// Each sets one field of `written` to `value`, checks every accessor of that field, expects the same value in `read`,
// and clears the field in `read`.
#define EXPECT_NUMBER(property, Property, value) \
  do {                                           \
    EXPECT_FALSE(written.has##Property());       \
    written.set##Property(value);                \
    EXPECT_TRUE(written.has##Property());        \
    EXPECT_EQ(written.property(), value);        \
    EXPECT_TRUE(read->has##Property());          \
    EXPECT_EQ(read->property(), value);          \
    read->setHas##Property(false);               \
    EXPECT_FALSE(read->has##Property());         \
  } while (false)

#define EXPECT_CONTENT(property, Property, value) \
  do {                                            \
    EXPECT_FALSE(written.has##Property());        \
    EXPECT_EQ(written.property(), nullptr);       \
    written.set##Property(value);                 \
    ASSERT_TRUE(written.has##Property());         \
    EXPECT_EQ(*written.property(), value);        \
    ASSERT_TRUE(read->has##Property());           \
    EXPECT_EQ(*read->property(), value);          \
    read->clear##Property();                      \
    EXPECT_FALSE(read->has##Property());          \
  } while (false)

#define EXPECT_MESSAGE(property, Property, value) \
  do {                                            \
    const auto sample = value;                    \
    EXPECT_FALSE(written.has##Property());        \
    written.set##Property(sample);                \
    ASSERT_TRUE(written.has##Property());         \
    EXPECT_EQ(written.property(), sample);        \
    ASSERT_TRUE(read->has##Property());           \
    EXPECT_EQ(*read->property(), *sample);        \
    read->set##Property(nullptr);                 \
    EXPECT_FALSE(read->has##Property());          \
  } while (false)

#define EXPECT_MESSAGES(property, Property, item, Item, ...)       \
  do {                                                             \
    const auto samples = __VA_ARGS__;                              \
    ASSERT_EQ(read->property##Count(), samples.size());            \
    for (std::size_t index = 0; index < samples.size(); ++index) { \
      EXPECT_EQ(written.property##Count(), index);                 \
      written.add##Item(samples[index]);                           \
      EXPECT_EQ(written.item##AtIndex(index), samples[index]);     \
      EXPECT_EQ(*read->item##AtIndex(index), *samples[index]);     \
    }                                                              \
    read->clear##Property();                                       \
    EXPECT_EQ(read->property##Count(), 0U);                        \
  } while (false)

#define EXPECT_NUMBERS(property, Property, item, Item, ...)        \
  do {                                                             \
    const auto samples = std::vector __VA_ARGS__;                  \
    ASSERT_EQ(read->property##Count(), samples.size());            \
    for (std::size_t index = 0; index < samples.size(); ++index) { \
      EXPECT_EQ(written.property##Count(), index);                 \
      written.add##Item(samples[index]);                           \
      EXPECT_EQ(written.property()[index], samples[index]);        \
      EXPECT_EQ(read->item##AtIndex(index), samples[index]);       \
    }                                                              \
    written.clear##Property();                                     \
    EXPECT_EQ(written.property##Count(), 0U);                      \
    written.set##Property(samples.data(), samples.size());         \
    EXPECT_EQ(written.property().size(), samples.size());          \
    read->clear##Property();                                       \
    EXPECT_EQ(read->property##Count(), 0U);                        \
  } while (false)
