#include "sources/RecogniseFile.h"

#include <string_view>

#include "capture/CaptureReader.h"
#include "platform/files/FormatHint.h"
#include "sources/diag/DiagStream.h"

namespace vespscope::sources {

bool isModemLog(const std::string& path) { return path != "-" && diag::DiagStream::open(path).ok(); }

Result<FileKind> recogniseFile(const std::string& path) {
  const auto capture = capture::CaptureReader::open(path);
  if (capture) return FileKind::capture;
  const auto log = diag::DiagStream::open(path);
  if (log) return FileKind::modemLog;
  // For an unreadable or empty file both report the same error.
  if (capture.reason() == log.reason()) return Failure{capture.reason()};
  const std::string_view hint = files::formatHintOf(path);
  const bool otherCapture = capture.reason().find(": link type ") != std::string::npos;
  if (otherCapture) return Failure{capture.reason()};
  return Failure{path + ": neither a capture nor a modem log" + (hint.empty() ? "" : ": " + std::string(hint))};
}

std::string sourceWords(FileKind kind, const std::string& path) {
  std::string words = kind == FileKind::capture ? "replay:" : "diag:";
  for (const char character : path) words.append(character == ',' ? 2 : 1, character);
  return words;
}

}  // namespace vespscope::sources
