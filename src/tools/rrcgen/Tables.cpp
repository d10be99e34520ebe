#include "rrcgen/Tables.h"

#include <algorithm>
#include <numeric>
#include <tuple>

namespace vespscope::rrcgen {
namespace {

using rrc::Kind;
using rrc::NameId;
using rrc::Type;
using rrc::TypeId;

constexpr std::size_t mostEntries = 0xFFFF;

// The values of a parameterised type's parameters where it is used.
using Arguments = std::map<std::string, TypeId, std::less<>>;

struct Scope {
  const Module& module;
  const Arguments& arguments;
};

class Builder {
 public:
  Builder(const std::vector<Module>& modules, const Selection& selection) : selection_(selection) {
    for (const Module& module : modules) modules_.emplace(module.name, &module);
    tables_.types.push_back({});
    nameId("");
  }

  Result<Tables> build() {
    for (const Selection::Pdu& pdu : selection_.pdus) {
      tables_.pdus.emplace_back(pdu.name, namedType(pdu.type));
    }
    if (failure_.empty() && tables_.types.size() > rrc::Field::optionalMark) failure_ = "too many types for the tables";
    if (failure_.empty() && names_.size() > mostEntries) failure_ = "too many names for the tables";
    if (!failure_.empty()) return Failure{failure_};
    sortNames();
    return std::move(tables_);
  }

 private:
  void fail(const std::string& what) {
    if (failure_.empty()) failure_ = what;
  }
  void fail(const Scope& scope, const Definition& type, const std::string& what) {
    fail(scope.module.file + ":" + std::to_string(type.line) + ": " + what);
  }

  NameId nameId(const std::string& name) {
    const auto [found, added] = names_.emplace(name, static_cast<NameId>(names_.size()));
    return found->second;
  }

  TypeId namedType(const TypeName& name) {
    const auto module = modules_.find(name.module);
    if (module == modules_.end()) {
      fail("module " + name.module + " is missing");
      return 0;
    }
    Definition reference;
    reference.kind = Kind::unknown;
    reference.reference = name.type;
    return typeOf({*module->second, {}}, reference);
  }

  TypeId typeOf(const Scope& scope, const Definition& type) {
    switch (type.kind) {
      case Kind::unknown:
        return referenced(scope, type);
      case Kind::sequence:
      case Kind::choice:
        return compound(scope, type, reserve());
      case Kind::enumerated:
        return enumeration(type);
      case Kind::integer:
        return share({number(Kind::integer), extensible(type), 0, 0, range(scope, type), 0});
      case Kind::bitString:
        return share({number(Kind::bitString), extensible(type), 0, 0, range(scope, type), 0});
      case Kind::octetString:
      case Kind::list: {
        const TypeId content = type.content ? typeOf(scope, *type.content) : TypeId{0};
        return share({number(type.kind), extensible(type), 0, 0, range(scope, type), content});
      }
      case Kind::null:
      case Kind::boolean:
        break;
    }
    return share({number(type.kind), 0, 0, 0, 0, 0});
  }

  static std::uint8_t number(Kind kind) { return static_cast<std::uint8_t>(kind); }
  static std::uint8_t extensible(const Definition& type) { return type.bounds && type.bounds->extensible ? 1 : 0; }

  // The type that a name refers to; compound types are made once for each name and its arguments.
  TypeId referenced(const Scope& scope, const Definition& reference) {
    if (const auto argument = scope.arguments.find(reference.reference); argument != scope.arguments.end()) {
      return argument->second;
    }
    const Module* module = &scope.module;
    auto found = module->types.find(reference.reference);
    if (const auto import = module->imports.find(reference.reference);
        found == module->types.end() && import != module->imports.end()) {
      const auto exporter = modules_.find(import->second);
      if (exporter != modules_.end()) {
        module = exporter->second;
        found = module->types.find(reference.reference);
      }
    }
    if (found == module->types.end()) {
      fail(scope, reference, reference.reference + " is not defined");
      return 0;
    }
    const TypeAssignment& assignment = found->second;
    if (assignment.parameters.size() != reference.arguments.size()) {
      fail(scope, reference, reference.reference + " has another number of parameters");
      return 0;
    }
    Arguments arguments;
    for (std::size_t index = 0; index < assignment.parameters.size(); ++index) {
      arguments[assignment.parameters[index]] = typeOf(scope, *reference.arguments[index]);
    }
    const Definition& type = *assignment.type;
    if (reference.bounds) {
      Definition bounded = type;
      bounded.bounds = reference.bounds;
      return typeOf({*module, arguments}, bounded);
    }
    if (type.kind != Kind::sequence && type.kind != Kind::choice) return typeOf({*module, arguments}, type);
    const auto [known, added] = compounds_.emplace(std::tuple(module, reference.reference, arguments), TypeId{0});
    if (added) {
      known->second = reserve();
      compound({*module, arguments}, type, known->second);
    }
    return known->second;
  }

  TypeId reserve() {
    tables_.types.push_back({});
    return static_cast<TypeId>(tables_.types.size() - 1);
  }

  TypeId compound(const Scope& scope, const Definition& type, TypeId id) {
    std::vector<rrc::Field> fields;
    std::uint16_t optional = 0;
    for (const Member& member : type.root) {
      fields.push_back(field(scope, member));
      if (member.optional) ++optional;
    }
    for (const Member& member : type.additions) fields.push_back(field(scope, member));
    Type& made = tables_.types[id];
    made.kindNumber = number(type.kind);
    made.extensible = type.extensible ? 1 : 0;
    made.count = static_cast<std::uint16_t>(type.root.size());
    made.extra = static_cast<std::uint16_t>(type.additions.size());
    made.range = type.kind == Kind::sequence ? optional : std::uint16_t{0};
    made.first = static_cast<std::uint32_t>(tables_.fields.size());
    tables_.fields.insert(tables_.fields.end(), fields.begin(), fields.end());
    return id;
  }

  rrc::Field field(const Scope& scope, const Member& member) {
    TypeId type = typeOf(scope, *member.type);
    if (const Selection::Content* content = contentOf(scope.module, member.name); content != nullptr) {
      Type with = tables_.types[type];
      if (with.kind() != Kind::octetString || with.first != 0) {
        fail(scope, *member.type, member.name + " is no byte string without content");
      }
      with.first = namedType(content->type);
      type = share(with);
    }
    return {nameId(member.name), static_cast<std::uint16_t>(member.optional ? type | rrc::Field::optionalMark : type)};
  }

  [[nodiscard]] const Selection::Content* contentOf(const Module& module, const std::string& field) const {
    const auto found = std::find_if(
        selection_.contents.begin(), selection_.contents.end(),
        [&](const Selection::Content& content) { return content.module == module.name && content.field == field; });
    return found == selection_.contents.end() ? nullptr : &*found;
  }

  TypeId enumeration(const Definition& type) {
    std::vector<NameId> items;
    for (const auto* names : {&type.items, &type.addedItems}) {
      for (const std::string& name : *names) items.push_back(nameId(name));
    }
    const auto [known, added] = items_.emplace(items, static_cast<std::uint32_t>(tables_.items.size()));
    if (added) tables_.items.insert(tables_.items.end(), items.begin(), items.end());
    return share({number(Kind::enumerated), static_cast<std::uint8_t>(type.extensible ? 1 : 0),
                  static_cast<std::uint16_t>(type.items.size()), static_cast<std::uint16_t>(type.addedItems.size()), 0,
                  known->second});
  }

  std::uint16_t range(const Scope& scope, const Definition& type) {
    rrc::Range range{type.kind == Kind::integer ? rrc::Range::unboundedBelow : 0, rrc::Range::unbounded};
    if (type.bounds && type.bounds->lower) range.lower = value(scope, type, *type.bounds->lower);
    if (type.bounds && type.bounds->upper) range.upper = value(scope, type, *type.bounds->upper);
    if (range.lower > range.upper) fail(scope, type, "the lower bound is above the upper bound");
    const auto [known, added] =
        ranges_.emplace(std::pair(range.lower, range.upper), static_cast<std::uint16_t>(tables_.ranges.size()));
    if (added) tables_.ranges.push_back(range);
    return known->second;
  }

  std::int64_t value(const Scope& scope, const Definition& type, const Number& bound) {
    if (const auto* literal = std::get_if<std::int64_t>(&bound)) return *literal;
    const std::string& name = std::get<std::string>(bound);
    const Module* module = &scope.module;
    if (const auto import = module->imports.find(name); import != module->imports.end()) {
      if (const auto exporter = modules_.find(import->second); exporter != modules_.end()) module = exporter->second;
    }
    const auto found = module->values.find(name);
    if (found == module->values.end()) {
      fail(scope, type, name + " is not defined");
      return 0;
    }
    return found->second;
  }

  TypeId share(const Type& type) {
    const auto key = std::tuple(type.kindNumber, type.extensible, type.count, type.extra, type.range, type.first);
    const auto [known, added] = shared_.emplace(key, static_cast<TypeId>(tables_.types.size()));
    if (added) tables_.types.push_back(type);
    return known->second;
  }

  void sortNames() {
    std::vector<NameId> sorted(names_.size());
    for (const auto& [name, id] : names_) {
      sorted[id] = static_cast<NameId>(tables_.names.size());
      tables_.names.push_back(name);
    }
    for (rrc::Field& field : tables_.fields) field.name = sorted[field.name];
    for (NameId& item : tables_.items) item = sorted[item];
  }

  const Selection& selection_;
  std::map<std::string, const Module*, std::less<>> modules_;
  std::map<std::tuple<const Module*, std::string, Arguments>, TypeId> compounds_;
  std::map<std::tuple<std::uint8_t, std::uint8_t, std::uint16_t, std::uint16_t, std::uint16_t, std::uint32_t>, TypeId>
      shared_;
  std::map<std::vector<NameId>, std::uint32_t> items_;
  std::map<std::pair<std::int64_t, std::int64_t>, std::uint16_t> ranges_;
  std::map<std::string, NameId> names_;
  Tables tables_;
  std::string failure_;
};

}  // namespace

Result<Tables> buildTables(const std::vector<Module>& modules, const Selection& selection) {
  return Builder(modules, selection).build();
}

}  // namespace vespscope::rrcgen
