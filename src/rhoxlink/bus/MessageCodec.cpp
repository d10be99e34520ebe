#include "rhoxlink/bus/MessageCodec.h"

#include <systemd/sd-bus.h>

#include <cerrno>
#include <cstring>
#include <string_view>
#include <type_traits>

#include "rhoxlink/bus/FrameChecker.h"
#include "values/Text.h"

namespace vespscope::bus {
namespace {

// The size of a message without its content: the header, the command or kind, a status (bytes).
constexpr std::size_t envelope = 1024;

// Keeps the first failure of a run of calls; later calls are skipped.
class Steps {
 public:
  template <class Call>
  Steps& then(Call call) {
    if (result_ >= 0) result_ = call();
    return *this;
  }
  [[nodiscard]] int result() const { return result_; }

 private:
  int result_ = 0;
};

int appendPlainText(sd_bus_message* message, const std::string& text) {
  // D-Bus text is UTF-8 without zero bytes; any other text is sent in printable form.
  const bool hasZero = text.find('\0') != std::string::npos;
  if (!hasZero) {
    if (text.size() > textLimit) return -EMSGSIZE;
    const int result = sd_bus_message_append_basic(message, SD_BUS_TYPE_STRING, text.c_str());
    if (result != -EINVAL) return result;
  }
  const std::string readable = printable(text);
  if (readable.size() > textLimit) return -EMSGSIZE;
  return sd_bus_message_append_basic(message, SD_BUS_TYPE_STRING, readable.c_str());
}

int appendDictionary(sd_bus_message* message, const ipc::Dictionary& dictionary, int depth);

int appendVariant(sd_bus_message* message, const char* signature, const auto& appendContents) {
  return Steps()
      .then([&] { return sd_bus_message_open_container(message, SD_BUS_TYPE_VARIANT, signature); })
      .then(appendContents)
      .then([&] { return sd_bus_message_close_container(message); })
      .result();
}

int appendObject(sd_bus_message* message, const ipc::Object& object, int depth) {
  if (depth >= depthLimit) return -EMSGSIZE;
  return std::visit(
      [message, depth](const auto& kind) {
        using Kind = std::decay_t<decltype(kind)>;
        if constexpr (std::is_same_v<Kind, std::monostate>) {
          return appendVariant(message, "g", [&] { return sd_bus_message_append_basic(message, 'g', ""); });
        } else if constexpr (std::is_same_v<Kind, bool>) {
          const int flag = kind ? 1 : 0;
          return appendVariant(message, "b", [&] { return sd_bus_message_append_basic(message, 'b', &flag); });
        } else if constexpr (std::is_same_v<Kind, std::int64_t>) {
          return appendVariant(message, "x", [&] { return sd_bus_message_append_basic(message, 'x', &kind); });
        } else if constexpr (std::is_same_v<Kind, std::uint64_t>) {
          return appendVariant(message, "t", [&] { return sd_bus_message_append_basic(message, 't', &kind); });
        } else if constexpr (std::is_same_v<Kind, double>) {
          return appendVariant(message, "d", [&] { return sd_bus_message_append_basic(message, 'd', &kind); });
        } else if constexpr (std::is_same_v<Kind, std::string>) {
          return appendVariant(message, "s", [&] { return appendPlainText(message, kind); });
        } else if constexpr (std::is_same_v<Kind, ipc::SharedBytes>) {
          return appendVariant(message, "ay",
                               [&] { return sd_bus_message_append_array(message, 'y', kind->data(), kind->size()); });
        } else if constexpr (std::is_same_v<Kind, ipc::Array>) {
          return appendVariant(message, "av", [&] {
            Steps steps;
            steps.then([&] { return sd_bus_message_open_container(message, SD_BUS_TYPE_ARRAY, "v"); });
            for (const ipc::Object& element : kind)
              steps.then([&] { return appendObject(message, element, depth + 1); });
            return steps.then([&] { return sd_bus_message_close_container(message); }).result();
          });
        } else {
          return appendVariant(message, "a{sv}", [&] { return appendDictionary(message, kind, depth + 1); });
        }
      },
      object.data());
}

int appendDictionary(sd_bus_message* message, const ipc::Dictionary& dictionary, int depth) {
  if (dictionary.size() > entryLimit) return -EMSGSIZE;
  Steps steps;
  steps.then([&] { return sd_bus_message_open_container(message, SD_BUS_TYPE_ARRAY, "{sv}"); });
  for (const auto& [key, object] : dictionary.entries()) {
    steps.then([&] { return sd_bus_message_open_container(message, SD_BUS_TYPE_DICT_ENTRY, "sv"); })
        .then([&, &entryKey = key] { return appendPlainText(message, entryKey); })
        .then([&, &entryObject = object] { return appendObject(message, entryObject, depth); })
        .then([&] { return sd_bus_message_close_container(message); });
  }
  return steps.then([&] { return sd_bus_message_close_container(message); }).result();
}

// The state of reading a message.
struct Reading {
  sd_bus_message* message;
  std::size_t objects = 0;  // read so far
};

int readObject(Reading& reading, ipc::Object& out, int depth);

int readText(sd_bus_message* message, const char*& text) {
  const int result = sd_bus_message_read_basic(message, SD_BUS_TYPE_STRING, &text);
  return result >= 0 && std::strlen(text) > textLimit ? -EBADMSG : result;
}

template <class Kind>
int readBasic(sd_bus_message* message, char type, ipc::Object& out) {
  Kind value{};
  const int result = sd_bus_message_read_basic(message, type, &value);
  if (result >= 0) out = ipc::Object(value);
  return result;
}

int readBytes(sd_bus_message* message, ipc::Object& out) {
  const void* data = nullptr;
  std::size_t size = 0;
  const int result = sd_bus_message_read_array(message, 'y', &data, &size);
  if (result < 0) return result;
  const auto* bytes = static_cast<const std::uint8_t*>(data);
  out = ipc::Object(size == 0 ? Bytes() : Bytes(bytes, bytes + size));
  return result;
}

int readDictionary(Reading& reading, ipc::Dictionary& out, int depth) {
  sd_bus_message* message = reading.message;
  int result = sd_bus_message_enter_container(message, SD_BUS_TYPE_ARRAY, "{sv}");
  if (result < 0) return result;
  while ((result = sd_bus_message_enter_container(message, SD_BUS_TYPE_DICT_ENTRY, "sv")) > 0) {
    const char* key = nullptr;
    ipc::Object value;
    result = Steps()
                 .then([&] { return readText(message, key); })
                 .then([&] { return readObject(reading, value, depth); })
                 .then([&] { return sd_bus_message_exit_container(message); })
                 .result();
    if (result < 0) return result;
    out.set(key, std::move(value));
    if (out.size() > entryLimit) return -EBADMSG;
  }
  return result < 0 ? result : sd_bus_message_exit_container(message);
}

int readArray(Reading& reading, ipc::Object& out, int depth) {
  sd_bus_message* message = reading.message;
  ipc::Array array;
  int result = sd_bus_message_enter_container(message, SD_BUS_TYPE_ARRAY, "v");
  if (result < 0) return result;
  while ((result = sd_bus_message_at_end(message, 0)) == 0) {
    ipc::Object element;
    if (result = readObject(reading, element, depth); result < 0) return result;
    array.push_back(std::move(element));
  }
  if (result < 0) return result;
  out = ipc::Object(std::move(array));
  return sd_bus_message_exit_container(message);
}

// Reads the contents of a variant with the signature `contents`.
int readContents(Reading& reading, std::string_view contents, ipc::Object& out, int depth) {
  sd_bus_message* message = reading.message;
  if (contents == "x") return readBasic<std::int64_t>(message, 'x', out);
  if (contents == "t") return readBasic<std::uint64_t>(message, 't', out);
  if (contents == "d") return readBasic<double>(message, 'd', out);
  if (contents == "ay") return readBytes(message, out);
  if (contents == "av") return readArray(reading, out, depth);
  if (contents == "b") {
    int flag = 0;
    const int result = sd_bus_message_read_basic(message, 'b', &flag);
    out = ipc::Object(flag != 0);
    return result;
  }
  if (contents == "s") {
    const char* text = nullptr;
    const int result = readText(message, text);
    if (result >= 0) out = ipc::Object(std::string(text));
    return result;
  }
  if (contents == "a{sv}") {
    ipc::Dictionary dictionary;
    const int result = readDictionary(reading, dictionary, depth);
    out = ipc::Object(std::move(dictionary));
    return result;
  }
  const char* signature = nullptr;
  if (contents != "g") return -EBADMSG;
  const int result = sd_bus_message_read_basic(message, 'g', &signature);
  return result >= 0 && *signature != '\0' ? -EBADMSG : result;
}

int readObject(Reading& reading, ipc::Object& out, int depth) {
  if (depth >= depthLimit || ++reading.objects > objectLimit) return -EBADMSG;
  sd_bus_message* message = reading.message;
  char type = 0;
  const char* contents = nullptr;
  const int result = sd_bus_message_peek_type(message, &type, &contents);
  if (result < 0 || type != SD_BUS_TYPE_VARIANT) return result < 0 ? result : -EBADMSG;
  return Steps()
      .then([&] { return sd_bus_message_enter_container(message, SD_BUS_TYPE_VARIANT, contents); })
      .then([&] { return readContents(reading, contents, out, depth + 1); })
      .then([&] { return sd_bus_message_exit_container(message); })
      .result();
}

}  // namespace

void MessageUnref::operator()(sd_bus_message* message) const { sd_bus_message_unref(message); }

int appendText(sd_bus_message* message, const std::string& text) { return appendPlainText(message, text); }

int appendDictionary(sd_bus_message* message, const ipc::Dictionary& dictionary) {
  // An object takes more memory here than in the message.
  if (ipc::contentSize(dictionary) > messageLimit - envelope) return -EMSGSIZE;
  return appendDictionary(message, dictionary, 0);
}

int readDictionary(sd_bus_message* message, ipc::Dictionary& out) {
  Reading reading{message};
  return readDictionary(reading, out, 0);
}

}  // namespace vespscope::bus
