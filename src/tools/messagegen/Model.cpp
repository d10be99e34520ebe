#include "messagegen/Model.h"

#include <algorithm>
#include <map>
#include <optional>
#include <set>
#include <utility>

namespace vespscope::messagegen {
namespace {

// Field numbers are read modulo 65536, so a greater one would never match.
constexpr std::uint32_t maximumFieldNumber = 65535;
constexpr std::size_t maximumNumbers = 64;

struct NumberType {
  std::string kind;
  std::string stored;
};

const std::map<std::string, NumberType>& numberTypes() {
  static const std::map<std::string, NumberType> types = {{"uint64", {"uint64", "std::uint64_t"}},
                                                          {"uint32", {"uint32", "std::uint32_t"}},
                                                          {"int32", {"int32", "std::int32_t"}},
                                                          {"sint32", {"sint32", "std::int32_t"}},
                                                          {"bool", {"boolean", "bool"}}};
  return types;
}

char lowered(char letter) { return letter >= 'A' && letter <= 'Z' ? static_cast<char>(letter - 'A' + 'a') : letter; }
char raised(char letter) { return letter >= 'a' && letter <= 'z' ? static_cast<char>(letter - 'a' + 'A') : letter; }

using Fault = std::optional<std::string>;

class Builder {
 public:
  explicit Builder(const std::vector<SchemaFile>& files) : files_(files) {}

  Result<std::vector<FileModel>> run() {
    if (Fault fault = collectTypes()) return Failure{*fault};
    std::vector<FileModel> models;
    for (const SchemaFile& file : files_) {
      FileModel model{&file, {}};
      for (const MessageType& message : file.messages) {
        MessageModel built{&message, {}, {}};
        if (Fault fault = build(message, built)) {
          return Failure{file.stem + ".proto:" + *fault};
        }
        model.messages.push_back(std::move(built));
      }
      models.push_back(std::move(model));
    }
    return models;
  }

 private:
  Fault collectTypes() {
    for (const SchemaFile& file : files_) {
      const auto add = [&](const std::string& name) {
        return types_.emplace(name, file.stem + "/" + name + ".h").second
                   ? Fault{}
                   : Fault{file.stem + ".proto: " + name + " is declared twice"};
      };
      for (const Enumeration& enumeration : file.enumerations) {
        enumerations_.insert(enumeration.name);
        if (Fault fault = add(enumeration.name)) return fault;
      }
      for (const MessageType& message : file.messages) {
        if (Fault fault = add(message.name)) return fault;
      }
    }
    return {};
  }

  Fault build(const MessageType& message, MessageModel& model) {
    std::set<std::uint32_t> numbers;
    std::set<std::string> names;
    std::set<std::string> includes;
    for (const Field& field : message.fields) {
      const auto fault = [&](const std::string& what) {
        return Fault{std::to_string(field.line) + ": " + message.name + "." + field.name + " " + what};
      };
      if (field.number == 0 || field.number > maximumFieldNumber) return fault("has an impossible number");
      if (!numbers.insert(field.number).second) return fault("has a number that is taken");
      FieldModel built;
      built.key = field.name;
      built.number = field.number;
      built.item = propertyName(field.name);
      built.property = field.repeated && built.item.back() != 's' ? built.item + "s" : built.item;
      if (!names.insert(built.property).second) return fault("has a name that is taken");
      if (Fault what = shape(message, field, built, includes)) return fault(*what);
      model.fields.push_back(std::move(built));
    }
    std::sort(model.fields.begin(), model.fields.end(),
              [](const FieldModel& one, const FieldModel& other) { return one.number < other.number; });
    model.includes.assign(includes.begin(), includes.end());
    if (!assignBits(model)) return std::to_string(message.line) + ": " + message.name + " has more than 64 numbers";
    return {};
  }

  Fault shape(const MessageType& message, const Field& field, FieldModel& built, std::set<std::string>& includes) {
    if (const auto number = numberTypes().find(field.type); number != numberTypes().end()) {
      if (field.repeated != field.packed) return "must be packed exactly when it is repeated";
      if (field.repeated && field.type == "bool") return "is a list of flags, which messages do not have";
      built.shape = field.repeated ? Shape::numberList : Shape::number;
      built.kind = number->second.kind;
      built.stored = number->second.stored;
      return {};
    }
    if (field.packed) return "cannot be packed";
    if (field.type == "bytes" || field.type == "string") {
      if (field.repeated) return "is a list of " + field.type + ", which messages do not have";
      built.shape = Shape::content;
      built.stored = field.type == "bytes" ? "Bytes" : "std::string";
      return {};
    }
    built.stored = field.type;
    const bool own = std::any_of(message.enumerations.begin(), message.enumerations.end(),
                                 [&](const Enumeration& enumeration) { return enumeration.name == field.type; });
    if (own || enumerations_.contains(field.type)) {
      if (field.repeated) return "is a list of enumeration values, which messages do not have";
      built.shape = Shape::enumeration;
      built.kind = "enumeration";
      if (!own) includes.insert(types_.at(field.type));
      return {};
    }
    const auto type = types_.find(field.type);
    if (type == types_.end()) return "has the unknown type " + field.type;
    built.shape = field.repeated ? Shape::messageList : Shape::message;
    includes.insert(type->second);
    embedded_[message.name].insert(field.type);
    if (reaches(field.type, message.name)) return "makes the message contain itself";
    return {};
  }

  [[nodiscard]] bool reaches(const std::string& from, const std::string& to) const {
    if (from == to) return true;
    const auto next = embedded_.find(from);
    return next != embedded_.end() && std::any_of(next->second.begin(), next->second.end(),
                                                  [&](const std::string& type) { return reaches(type, to); });
  }

  // The 64-bit numbers come first, then the others in alphabetical order of their properties.
  static bool assignBits(MessageModel& model) {
    std::vector<FieldModel*> numbers;
    for (FieldModel& field : model.fields) {
      if (field.shape == Shape::number || field.shape == Shape::enumeration) numbers.push_back(&field);
    }
    std::sort(numbers.begin(), numbers.end(), [](const FieldModel* one, const FieldModel* other) {
      return std::pair(one->kind != "uint64", one->property) < std::pair(other->kind != "uint64", other->property);
    });
    if (numbers.size() > maximumNumbers) return false;
    for (std::size_t index = 0; index < numbers.size(); ++index) numbers[index]->bit = static_cast<unsigned>(index);
    while (model.presenceWidth < numbers.size()) model.presenceWidth *= 2;
    return true;
  }

  const std::vector<SchemaFile>& files_;
  std::map<std::string, std::string> types_;  // type and its header
  std::set<std::string> enumerations_;
  std::map<std::string, std::set<std::string>> embedded_;
};

}  // namespace

std::string propertyName(const std::string& key) {
  std::string name;
  bool pieceStarts = false;
  for (const char letter : key) {
    if (letter == '_') {
      pieceStarts = true;
    } else {
      name += pieceStarts ? raised(letter) : letter;
      pieceStarts = false;
    }
  }
  if (!name.empty()) name.front() = lowered(name.front());
  return name;
}

std::string capitalized(std::string name) {
  if (!name.empty()) name.front() = raised(name.front());
  return name;
}

Result<std::vector<FileModel>> buildModel(const std::vector<SchemaFile>& files) { return Builder(files).run(); }

}  // namespace vespscope::messagegen
