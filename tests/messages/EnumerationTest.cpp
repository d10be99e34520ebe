// Names of enumeration values; data/enumerations.txt lists all of them with their fields.
#include <algorithm>
#include <fstream>
#include <limits>
#include <map>
#include <sstream>
#include <string>

#include <gtest/gtest.h>

#include "messages/Enumeration.h"
#include "messages/MessageClasses.h"
#include "messages/MessageTesting.h"
#include "messages/WireWriter.h"

namespace vespscope::test {
namespace {

struct EnumerationUse {
  std::string message;
  std::uint32_t number = 0;
  std::string field;
  bool operator<(const EnumerationUse& other) const {
    return std::tie(message, number) < std::tie(other.message, other.number);
  }
};

using ListedNames = std::map<EnumerationUse, std::map<std::int32_t, std::string>>;

ListedNames listedNames() {
  ListedNames result;
  std::ifstream file(VESPSCOPE_SOURCE_DIR "/tests/messages/data/enumerations.txt");
  for (std::string line; std::getline(file, line);) {
    if (line.starts_with('#')) continue;
    std::istringstream words(line);
    EnumerationUse use;
    std::int32_t value = 0;
    std::string name;
    words >> use.message >> use.number >> use.field >> value >> name;
    EXPECT_TRUE(words) << line;
    result[use][value] = name;
  }
  return result;
}

std::shared_ptr<WireMessage> make(const std::string& name) {
  const auto classes = messageClasses();
  const auto found =
      std::find_if(classes.begin(), classes.end(), [&](const auto& entry) { return entry.name == name; });
  return found == classes.end() ? nullptr : found->make();
}

// The message's dictionary for `value`.
std::string shown(const EnumerationUse& use, std::int32_t value) {
  WireWriter writer;
  writer.writeInt32(value, use.number);
  const auto message = make(use.message);
  if (message == nullptr) return "no message " + use.message;
  WireReader reader(writer.bytes());
  EXPECT_TRUE(message->readFrom(reader));
  const Record dictionary = message->dictionaryRepresentation();
  const Value* text = dictionary.find(use.field);
  if (text == nullptr || text->asText() == nullptr || dictionary.size() != 1) return "no text " + use.field;
  return *text->asText();
}

TEST(Enumeration, EveryListedValueIsShownByItsName) {
  const ListedNames listed = listedNames();
  EXPECT_EQ(listed.size(), 31U);
  for (const auto& [use, names] : listed) {
    for (const auto& [value, name] : names) EXPECT_EQ(shown(use, value), name) << use.message << "." << use.field;
  }
}

TEST(Enumeration, NoOtherValueHasAName) {
  for (const auto& [use, names] : listedNames()) {
    std::vector<std::int32_t> values = {std::numeric_limits<std::int32_t>::min(), -255, 256, 1000, 65536,
                                        std::numeric_limits<std::int32_t>::max()};
    for (std::int32_t value = -2; value < 256; ++value) values.push_back(value);
    for (const std::int32_t value : values) {
      if (names.contains(value)) continue;
      EXPECT_EQ(shown(use, value), "(unknown: " + std::to_string(value) + ")") << use.message << "." << use.field;
    }
  }
}

TEST(Enumeration, ANameIsFoundInSparseTablesToo) {
  static constexpr EnumerationName sparse[] = {{-3, "below"}, {1, "one"}, {2, "two"}, {95, "far"}};
  EXPECT_EQ(enumerationName(sparse, -3), "below");
  EXPECT_EQ(enumerationName(sparse, 1), "one");
  EXPECT_EQ(enumerationName(sparse, 2), "two");
  EXPECT_EQ(enumerationName(sparse, 95), "far");
  for (const std::int32_t value : {-4, -1, 0, 3, 94, 96}) EXPECT_EQ(enumerationName(sparse, value), std::nullopt);
  EXPECT_EQ(enumerationName({}, 0), std::nullopt);
}

TEST(Enumeration, AValueWithoutANameIsShownAsItsNumberWithItsSign) {
  static constexpr EnumerationName one[] = {{0, "ZERO"}};
  EXPECT_EQ(enumerationText(one, 0), "ZERO");
  EXPECT_EQ(enumerationText(one, 99), "(unknown: 99)");
  EXPECT_EQ(enumerationText(one, -1), "(unknown: -1)");
  EXPECT_EQ(enumerationText(one, std::numeric_limits<std::int32_t>::min()), "(unknown: -2147483648)");
}

}  // namespace
}  // namespace vespscope::test
