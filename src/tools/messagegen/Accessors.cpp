#include "messagegen/Accessors.h"

namespace vespscope::messagegen {
namespace {

constexpr const char* numberAccessors = R"(  [[nodiscard]] @stored@ @property@() const noexcept { return _@property@; }
)";

constexpr const char* enumerationAccessors =
    R"(  // A value of @scope@, its first one when not set; numbers without a name occur.
  [[nodiscard]] @stored@ @property@() const noexcept { return has@Property@() ? _@property@ : @scope@::firstDeclared; }
)";

constexpr const char* presenceAccessors =
    R"(  void set@Property@(@stored@ @property@) noexcept {
    _@property@ = @property@;
    _has.set(@bit@);
  }
  void setHas@Property@(bool present) noexcept { _has.set(@bit@, present); }
  [[nodiscard]] bool has@Property@() const noexcept { return _has.test(@bit@); }
)";

constexpr const char* contentAccessors =
    R"(  // Null when absent.
  [[nodiscard]] const @stored@* @property@() const noexcept { return _@property@.get(); }
  void set@Property@(@stored@ @property@) { _@property@ = std::make_shared<const @stored@>(std::move(@property@)); }
  void clear@Property@() noexcept { _@property@ = nullptr; }
  [[nodiscard]] bool has@Property@() const noexcept { return _@property@ != nullptr; }
)";

constexpr const char* messageAccessors =
    R"(  // Null when absent.
  [[nodiscard]] std::shared_ptr<@stored@> @property@() const noexcept { return _@property@; }
  void set@Property@(std::shared_ptr<@stored@> @property@) noexcept { _@property@ = std::move(@property@); }
  [[nodiscard]] bool has@Property@() const noexcept { return _@property@ != nullptr; }
)";

constexpr const char* messageListAccessors =
    R"(  void clear@Property@() noexcept { _@property@.clear(); }
  void add@Item@(std::shared_ptr<@stored@> @item@) { _@property@.add(std::move(@item@)); }
  [[nodiscard]] std::size_t @property@Count() const noexcept { return _@property@.size(); }
  [[nodiscard]] const std::shared_ptr<@stored@>& @item@AtIndex(std::size_t index) const { return _@property@.at(index); }
)";

constexpr const char* numberListAccessors =
    R"(  [[nodiscard]] std::size_t @property@Count() const noexcept { return _@property@.size(); }
  [[nodiscard]] std::span<const @stored@> @property@() const noexcept { return _@property@.values(); }
  void clear@Property@() noexcept { _@property@.clear(); }
  void add@Item@(@stored@ @item@) { _@property@.add(@item@); }
  [[nodiscard]] @stored@ @item@AtIndex(std::size_t index) const { return _@property@.at(index); }
  void set@Property@(const @stored@* values, std::size_t count) { _@property@.assign(values, count); }
)";

std::vector<Replacement> names(const FieldModel& field) {
  const bool enumeration = field.shape == Shape::enumeration;
  return {{"stored", enumeration ? "std::int32_t" : field.stored},
          {"scope", field.stored},
          {"property", field.property},
          {"Property", capitalized(field.property)},
          {"item", field.item},
          {"Item", capitalized(field.item)},
          {"bit", std::to_string(field.bit)},
          {"number", std::to_string(field.number)},
          {"kind", field.kind},
          {"key", field.key}};
}

}  // namespace

std::string fill(std::string pattern, const std::vector<Replacement>& replacements) {
  for (const Replacement& replacement : replacements) {
    const std::string mark = "@" + replacement.name + "@";
    for (std::size_t found = pattern.find(mark); found != std::string::npos; found = pattern.find(mark, found)) {
      pattern.replace(found, mark.size(), replacement.text);
      found += replacement.text.size();
    }
  }
  return pattern;
}

std::string accessors(const FieldModel& field) {
  const char* pattern = nullptr;
  switch (field.shape) {
    case Shape::number:
      return fill(std::string(numberAccessors) + presenceAccessors, names(field));
    case Shape::enumeration:
      return fill(std::string(enumerationAccessors) + presenceAccessors, names(field));
    case Shape::content:
      pattern = contentAccessors;
      break;
    case Shape::message:
      pattern = messageAccessors;
      break;
    case Shape::messageList:
      pattern = messageListAccessors;
      break;
    case Shape::numberList:
      pattern = numberListAccessors;
      break;
  }
  return fill(pattern, names(field));
}

std::string storage(const FieldModel& field) {
  const char* pattern = nullptr;
  switch (field.shape) {
    case Shape::number:
    case Shape::enumeration:
      pattern = field.stored == "bool" ? "@stored@ _@property@ = false;" : "@stored@ _@property@ = 0;";
      break;
    case Shape::content:
      pattern = "std::shared_ptr<const @stored@> _@property@;";
      break;
    case Shape::message:
      pattern = "std::shared_ptr<@stored@> _@property@;";
      break;
    case Shape::messageList:
      pattern = "MessageList<@stored@> _@property@;";
      break;
    case Shape::numberList:
      pattern = "NumberList<@stored@> _@property@;";
      break;
  }
  return fill(pattern, names(field));
}

std::string tableEntry(const FieldModel& field) {
  const char* pattern = nullptr;
  switch (field.shape) {
    case Shape::number:
      pattern = R"(numberField<NumberKind::@kind@>(@number@, "@key@", &Self::_@property@, @bit@))";
      break;
    case Shape::enumeration:
      pattern = R"(enumerationField(@number@, "@key@", &Self::_@property@, @bit@, @scope@::names))";
      break;
    case Shape::content:
      pattern = R"(contentField(@number@, "@key@", &Self::_@property@))";
      break;
    case Shape::message:
      pattern = R"(messageField(@number@, "@key@", &Self::_@property@))";
      break;
    case Shape::messageList:
      pattern = R"(messageListField(@number@, "@key@", &Self::_@property@))";
      break;
    case Shape::numberList:
      pattern = R"(numberListField<NumberKind::@kind@>(@number@, "@key@", &Self::_@property@))";
      break;
  }
  return fill(pattern, names(field));
}

}  // namespace vespscope::messagegen
