// Text rendering of values, the same for screen rows and log lines.
//
// Integers are decimal digits; booleans `1`/`0`; floating point the shortest text that reads back, with `.0` if
// integral; text itself; bytes lower-case hexadecimal pairs in angle brackets (`<13 00 14>`); records
// `[key: value, …]`; lists `[a, b]`. The result is one line of valid UTF-8: bytes that are not
// UTF-8 become U+FFFD, control characters become their visible picture (U+2400 and up).
#pragma once

#include <string>
#include <string_view>

#include "values/Value.h"

namespace vespscope {

[[nodiscard]] std::string toText(const Value& value);
[[nodiscard]] std::string toText(const Record& record);
void appendText(std::string& out, const Value& value);
void appendText(std::string& out, const Record& record);

// One line of valid UTF-8 without control characters, made from any bytes.
void appendPrintable(std::string& out, std::string_view text);
[[nodiscard]] std::string printable(std::string_view text);
// True for printable ASCII alone, which is always shown as it is.
[[nodiscard]] bool isPlain(std::string_view text);

// Shortest decimal text that reads back as the same number, with `.0` if integral.
void appendNumber(std::string& out, float number);
void appendNumber(std::string& out, double number);

}  // namespace vespscope
