#include "rrcgen/Writer.h"

#include <utility>

namespace vespscope::rrcgen {
namespace {

constexpr std::size_t lineLength = 120;
constexpr const char* mark = "// Written by rrcgen; do not edit.\n";

// Joins pieces into lines of bounded length.
class Lines {
 public:
  void add(const std::string& piece) {
    if (line_.size() + piece.size() > lineLength) {
      text_ += line_ + "\n";
      line_.clear();
    }
    line_ += piece;
  }
  [[nodiscard]] std::string text() const { return mark + text_ + line_ + "\n"; }

 private:
  std::string text_;
  std::string line_;
};

template <class... Numbers>
std::string row(Numbers... numbers) {
  std::string text;
  ((text += (text.empty() ? "{" : ",") + std::to_string(numbers)), ...);
  return text + "},";
}

std::string bound(std::int64_t number) {
  if (number == rrc::Range::unbounded) return "Range::unbounded";
  if (number == rrc::Range::unboundedBelow) return "Range::unboundedBelow";
  return std::to_string(number);
}

// Writes all names without separators, as adjacent literals, and the offset of each.
void writeNames(const std::vector<std::string>& names, GeneratedFiles& files) {
  std::string text = mark;
  std::string line;
  Lines offsets;
  std::size_t offset = 0;
  for (const std::string& name : names) {
    offsets.add(std::to_string(offset) + ",");
    offset += name.size();
    if (line.size() + name.size() + 2 > lineLength) {
      text += "\"" + line + "\"\n";
      line.clear();
    }
    line += name;
  }
  offsets.add(std::to_string(offset) + ",");
  files["Names.inc"] = text + "\"" + line + "\"\n";
  files["NameOffsets.inc"] = offsets.text();
}

}  // namespace

GeneratedFiles write(const Tables& tables) {
  GeneratedFiles files;
  Lines types;
  for (const rrc::Type& type : tables.types) {
    types.add(row(type.kindNumber, type.extensible, type.count, type.extra, type.range, type.first));
  }
  Lines fields;
  for (const rrc::Field& field : tables.fields) fields.add(row(field.name, field.typeAndOptional));
  Lines items;
  for (const rrc::NameId item : tables.items) items.add(std::to_string(item) + ",");
  Lines ranges;
  for (const rrc::Range& range : tables.ranges) {
    ranges.add("{" + bound(range.lower) + "," + bound(range.upper) + "},");
  }
  std::string pdus = mark;
  for (const auto& [name, type] : tables.pdus) pdus += name + " = " + std::to_string(type) + ",\n";
  files["Types.inc"] = types.text();
  files["Fields.inc"] = fields.text();
  files["Items.inc"] = items.text();
  files["Ranges.inc"] = ranges.text();
  files["Pdus.inc"] = pdus;
  writeNames(tables.names, files);
  return files;
}

Result<GeneratedFiles> generateFrom(const std::filesystem::path& definitions, const std::filesystem::path& selection) {
  const auto selectionText = generation::contentOf(selection);
  if (!selectionText) return Failure{selection.string() + ": cannot be read"};
  const auto selected = parseSelection(selection.string(), *selectionText);
  if (!selected) return Failure{selected.reason()};

  const auto paths = generation::filesOf(definitions, ".asn");
  if (!paths) return Failure{paths.reason()};
  std::vector<Module> modules;
  for (const auto& path : *paths) {
    const auto text = generation::contentOf(path);
    if (!text) return Failure{path.string() + ": cannot be read"};
    auto module = parseModule(path.string(), *text);
    if (!module) return Failure{module.reason()};
    modules.push_back(std::move(*module));
  }
  const auto tables = buildTables(modules, *selected);
  if (!tables) return Failure{tables.reason()};
  return write(*tables);
}

}  // namespace vespscope::rrcgen
