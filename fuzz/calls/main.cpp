// accessor_calls SCHEMA_FOLDER OUTPUT: writes a call of every accessor of every message.
#include <cstdio>
#include <fstream>

#include "messagegen/Generator.h"
#include "messagegen/Model.h"

using namespace vespscope::messagegen;

namespace {

void writeCalls(std::ostream& out, const FieldModel& field) {
  const std::string& property = field.property;
  const std::string present = "has" + capitalized(property) + "()";
  switch (field.shape) {
    case Shape::number:
    case Shape::enumeration:
      out << "  keep(message." << property << "(), message." << present << ");\n";
      break;
    case Shape::content:
      out << "  keep(message." << property << "() != nullptr ? message." << property << "()->size() : 0, message."
          << present << ");\n";
      break;
    case Shape::message:
      out << "  if (message." << present << ") call(*message." << property << "());\n";
      break;
    case Shape::messageList:
      out << "  for (std::size_t index = 0; index < message." << property << "Count(); ++index) call(*message."
          << field.item << "AtIndex(index));\n";
      break;
    case Shape::numberList:
      out << "  for (std::size_t index = 0; index < message." << property << "Count(); ++index) {\n"
          << "    keep(message." << field.item << "AtIndex(index), message." << property << "()[index] == message."
          << field.item << "AtIndex(index));\n  }\n";
      break;
  }
}

}  // namespace

int main(int count, char** arguments) {
  if (count != 3) return 2;
  const auto files = readSchema(arguments[1]);
  if (!files) return std::fprintf(stderr, "accessor_calls: %s\n", files.reason().c_str()), 2;
  const auto models = buildModel(*files);
  if (!models) return std::fprintf(stderr, "accessor_calls: %s\n", models.reason().c_str()), 2;
  std::ofstream out(arguments[2]);
  out << "#include \"Peer.h\"\n";
  for (const FileModel& file : *models) {
    for (const MessageModel& message : file.messages) {
      out << "#include \"messages/" << file.file->stem << "/" << message.declaration->name << ".h\"\n";
    }
  }
  out << "\nnamespace vespscope::fuzz {\nnamespace {\n\nvolatile std::uint64_t kept;\n\n"
         "template <class Number>\nvoid keep(Number number, bool present) {\n"
         "  kept = static_cast<std::uint64_t>(number) + (present ? 1U : 0U);\n}\n\n";
  for (const FileModel& file : *models) {
    for (const MessageModel& message : file.messages) {
      out << "void call(const " << message.declaration->name << "& message);\n";
    }
  }
  for (const FileModel& file : *models) {
    for (const MessageModel& message : file.messages) {
      out << "\nvoid call(const " << message.declaration->name << "& message) {\n";
      for (const FieldModel& field : message.fields) writeCalls(out, field);
      out << "}\n";
    }
  }
  out << "\n}  // namespace\n\nvoid callAccessors(const WireMessage& message) {\n";
  for (const FileModel& file : *models) {
    for (const MessageModel& message : file.messages) {
      const std::string& name = message.declaration->name;
      out << "  if (const auto* same = dynamic_cast<const " << name << "*>(&message)) return call(*same);\n";
    }
  }
  out << "}\n\n}  // namespace vespscope::fuzz\n";
  out.close();
  return out ? 0 : 2;
}
