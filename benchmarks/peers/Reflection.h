// Converts Protobuf messages into dictionaries by reflection, as code does that knows no message class.
#pragma once

#include <cstdint>
#include <map>
#include <string>
#include <variant>
#include <vector>

#include <google/protobuf/descriptor.h>
#include <google/protobuf/message.h>
#include <google/protobuf/reflection.h>

namespace peers {

struct MapValue;
using Map = std::map<std::string, MapValue>;
struct MapValue {
  std::variant<bool, std::uint32_t, std::int32_t, std::uint64_t, std::string, std::vector<MapValue>, Map> data;
};

template <class Dictionary>
void reflect(const google::protobuf::Message& message, Dictionary& out) {
  using Field = google::protobuf::FieldDescriptor;
  const google::protobuf::Reflection& in = *message.GetReflection();
  std::vector<const Field*> fields;
  in.ListFields(message, &fields);
  out.reserve(fields.size());
  for (const Field* field : fields) {
    if (field->is_repeated() && field->cpp_type() == Field::CPPTYPE_MESSAGE) {
      for (int index = 0; index < in.FieldSize(message, field); ++index) {
        reflect(in.GetRepeatedMessage(message, field, index), out.element(field->name()));
      }
      continue;
    }
    if (field->is_repeated()) {
      if (field->cpp_type() == Field::CPPTYPE_UINT32) {
        out.numbers(field->name(), in.GetRepeatedFieldRef<std::uint32_t>(message, field));
      } else {
        out.numbers(field->name(), in.GetRepeatedFieldRef<std::int32_t>(message, field));
      }
      continue;
    }
    switch (field->cpp_type()) {
      case Field::CPPTYPE_MESSAGE:
        reflect(in.GetMessage(message, field), out.embedded(field->name()));
        break;
      case Field::CPPTYPE_UINT64:
        out.number(field->name(), std::uint64_t{in.GetUInt64(message, field)});
        break;
      case Field::CPPTYPE_UINT32:
        out.number(field->name(), std::uint32_t{in.GetUInt32(message, field)});
        break;
      case Field::CPPTYPE_INT32:
        out.number(field->name(), std::int32_t{in.GetInt32(message, field)});
        break;
      case Field::CPPTYPE_BOOL:
        out.number(field->name(), in.GetBool(message, field));
        break;
      case Field::CPPTYPE_ENUM:
        out.enumeration(field->name(), in.GetEnum(message, field)->name(), in.GetEnumValue(message, field));
        break;
      default:
        out.text(field->name(), in.GetString(message, field));
    }
  }
}

// The interface of the other dictionaries, implemented with std::map.
class MapDictionary {
 public:
  explicit MapDictionary(Map& map) : map_(map) {}
  void reserve(std::size_t /*count*/) {}
  template <class Number>
  void number(const std::string& name, Number value) {
    map_[name].data = value;
  }
  void text(const std::string& name, std::string value) { map_[name].data = std::move(value); }
  void enumeration(const std::string& name, const std::string& value, std::int32_t /*number*/) { text(name, value); }
  MapDictionary embedded(const std::string& name) { return MapDictionary(map_[name].data.emplace<Map>()); }
  MapDictionary element(const std::string& name) {
    auto& value = map_[name].data;
    if (!std::holds_alternative<std::vector<MapValue>>(value)) value.emplace<std::vector<MapValue>>();
    return MapDictionary(std::get<std::vector<MapValue>>(value).emplace_back().data.emplace<Map>());
  }
  template <class Range>
  void numbers(const std::string& name, const Range& range) {
    auto& list = map_[name].data.emplace<std::vector<MapValue>>();
    for (const auto value : range) list.push_back({value});
  }

 private:
  Map& map_;
};
inline void reflect(const google::protobuf::Message& message, MapDictionary&& out) {
  reflect<MapDictionary>(message, out);
}

}  // namespace peers
