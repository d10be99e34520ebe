#include "messagegen/Writer.h"

#include <algorithm>
#include <map>
#include <set>

#include "messagegen/Accessors.h"

namespace vespscope::messagegen {
namespace {

constexpr const char* headerPattern = R"(// @comment@
//
// Written by messagegen from schema/@stem@.proto; change it there.
// clang-format off
#pragma once

@includes@
namespace vespscope {

@body@
}  // namespace vespscope
)";

constexpr const char* sourcePattern = R"(// The operations of the messages of schema/@stem@.proto.
//
// Written by messagegen; change it there.
// clang-format off
#include "messages/MessageOperations.h"

@includes@
namespace vespscope {

@body@
}  // namespace vespscope
)";

constexpr const char* classPattern = R"(class @name@ final : public Message<@name@> {
 public:
  static constexpr std::string_view className = "@name@";

@enumerations@@accessors@  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(@table@);
  }

 private:
  friend class Message<@name@>;

@storage@  Presence<std::uint@width@_t> _has;
};

extern template class Message<@name@>;
)";

constexpr const char* enumerationPattern = R"(// @comment@
struct @name@ {
  enum : std::int32_t {
@values@  };
  // What a field that is not set reads as.
  static constexpr std::int32_t firstDeclared = @first@;
  static constexpr EnumerationName names[] = {
@names@  };
  // The name of `number`, if it has one.
  [[nodiscard]] static std::optional<std::string_view> nameOf(std::int32_t number) { return enumerationName(names, number); }
};
)";

constexpr const char* classesPattern = R"(// Every message class by its name.
//
// Written by messagegen; change it there.
// clang-format off
#include "messages/MessageClasses.h"

@includes@
namespace vespscope {
namespace {

template <class Class>
constexpr MessageClass entry{Class::className, []() -> std::shared_ptr<WireMessage> { return std::make_shared<Class>(); }};

constexpr MessageClass classes[] = {
@body@};

}  // namespace

std::span<const MessageClass> messageClasses() { return classes; }

}  // namespace vespscope
)";

std::string indented(const std::string& text) {
  std::string result;
  std::size_t start = 0;
  while (start < text.size()) {
    const std::size_t end = text.find('\n', start);
    if (end > start) result += "  ";
    result += text.substr(start, end - start + 1);
    start = end + 1;
  }
  return result;
}

std::string enumeration(const Enumeration& declaration) {
  std::string values;
  for (const EnumerationValue& value : declaration.values) {
    values += "    " + value.name + " = " + std::to_string(value.number) + ",\n";
  }
  std::vector<EnumerationValue> sorted = declaration.values;
  std::sort(sorted.begin(), sorted.end(), [](const auto& one, const auto& other) { return one.number < other.number; });
  std::string names;
  for (const EnumerationValue& value : sorted) names += "    {" + value.name + ", \"" + value.name + "\"},\n";
  return fill(enumerationPattern, {{"comment", declaration.comment},
                                   {"name", declaration.name},
                                   {"first", declaration.values.front().name},
                                   {"values", values},
                                   {"names", names}});
}

std::string includeLines(const std::vector<std::string>& system, const std::vector<std::string>& own) {
  std::string lines;
  for (const std::string& name : system) lines += "#include <" + name + ">\n";
  if (!system.empty()) lines += "\n";
  for (const std::string& name : own) lines += "#include \"messages/" + name + "\"\n";
  return lines;
}

std::string enumerationHeader(const SchemaFile& file, const Enumeration& declaration) {
  return fill(headerPattern, {{"comment", "Values of an enumeration that several messages share."},
                              {"stem", file.stem},
                              {"includes", includeLines({"cstdint", "optional", "string_view"}, {"Enumeration.h"})},
                              {"body", enumeration(declaration)}});
}

// Stores members in descending order of alignment, to avoid padding.
int alignmentOrder(const FieldModel& field) {
  if (field.shape != Shape::number && field.shape != Shape::enumeration) return 1;
  if (field.kind == "uint64") return 0;
  return field.kind == "boolean" ? 3 : 2;
}

std::string messageHeader(const SchemaFile& file, const MessageModel& message) {
  std::string enumerations;
  for (const Enumeration& nested : message.declaration->enumerations) {
    enumerations += indented(enumeration(nested)) + "\n";
  }
  std::set<std::string> system = {"cstdint", "string_view", "tuple"};
  if (!message.declaration->enumerations.empty()) system.insert("optional");
  std::string accessorLines;
  std::string table;
  for (const FieldModel& field : message.fields) {
    accessorLines += accessors(field) + "\n";
    table += (table.empty() ? "\n        " : ",\n        ") + tableEntry(field);
    const bool list = field.shape == Shape::messageList || field.shape == Shape::numberList;
    if (list) system.insert("cstddef");
    if (field.shape == Shape::numberList) system.insert("span");
    if (field.stored == "std::string") system.insert("string");
    if (field.shape == Shape::content || field.shape == Shape::message || field.shape == Shape::messageList) {
      system.insert({"memory", "utility"});
    }
  }
  // Sorted by alignment; members of the same alignment keep the order of declaration.
  std::multimap<int, const FieldModel*> stored;
  for (const FieldModel& field : message.fields) stored.emplace(alignmentOrder(field), &field);
  std::string storageLines;
  for (const auto& [order, field] : stored) storageLines += "  " + storage(*field) + "\n";

  std::vector<std::string> own = message.includes;
  own.emplace_back("Message.h");
  std::sort(own.begin(), own.end());
  const std::string body = fill(classPattern, {{"enumerations", enumerations},
                                               {"accessors", accessorLines},
                                               {"table", table},
                                               {"storage", storageLines},
                                               {"width", std::to_string(message.presenceWidth)},
                                               {"name", message.declaration->name}});
  return fill(headerPattern, {{"comment", message.declaration->comment},
                              {"stem", file.stem},
                              {"includes", includeLines({system.begin(), system.end()}, own)},
                              {"body", body}});
}

}  // namespace

GeneratedFiles generate(const std::vector<FileModel>& models) {
  GeneratedFiles files;
  std::vector<std::string> allHeaders;
  std::string allEntries;
  for (const FileModel& model : models) {
    const SchemaFile& file = *model.file;
    for (const Enumeration& declaration : file.enumerations) {
      files[file.stem + "/" + declaration.name + ".h"] = enumerationHeader(file, declaration);
    }
    if (model.messages.empty()) continue;
    std::vector<std::string> headers;
    std::string body;
    for (const MessageModel& message : model.messages) {
      const std::string& name = message.declaration->name;
      headers.push_back(file.stem + "/" + name + ".h");
      files[headers.back()] = messageHeader(file, message);
      body += "template class Message<" + name + ">;\n";
      allEntries += "    entry<" + name + ">,\n";
    }
    std::sort(headers.begin(), headers.end());
    files[file.stem + "/" + capitalized(file.stem) + "Messages.cpp"] =
        fill(sourcePattern, {{"stem", file.stem}, {"includes", includeLines({}, headers)}, {"body", body}});
    allHeaders.insert(allHeaders.end(), headers.begin(), headers.end());
  }
  std::sort(allHeaders.begin(), allHeaders.end());
  files["MessageClasses.cpp"] =
      fill(classesPattern, {{"includes", includeLines({}, allHeaders)}, {"body", allEntries}});
  return files;
}

}  // namespace vespscope::messagegen
