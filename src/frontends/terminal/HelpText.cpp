#include "frontends/terminal/HelpText.h"

#include <algorithm>
#include <array>

namespace vespscope::terminal {
namespace {

struct Entry {
  const char* key;  // without text: the title of a group
  const char* text;
};

constexpr std::array<Entry, 28> entries = {{
    {"Moving", nullptr},
    {"up down, k j", "previous, next row"},
    {"PgUp PgDn", "page up, page down"},
    {"Home End, g G", "first, last row"},
    {"enter, right", "open the row"},
    {"esc, left, h", "back, or close help and log"},
    {"mouse",
     "click opens a row or goes back along the path, the wheel scrolls; with shift held most terminals select "
     "text"},
    {"Looking", nullptr},
    {"/", "filter rows by label or value, or log lines; enter keeps the filter, esc clears it"},
    {"r", "read the values again now"},
    {"l", "log: the last lines of the system log (sys) and of standard output (out)"},
    {"?", "this help"},
    {"Ctrl-L", "draw the screen anew"},
    {"Ctrl-Z", "suspend"},
    {"q, Ctrl-C", "quit"},
    {"Marks", nullptr},
    {"*", "the value changed, or the row is new, since the screen was read before"},
    {">", "selecting the row leads on"},
    {"Status line", nullptr},
    {"LIVE", "values come from a modem at this moment"},
    {"RECORDED", "values come from a recording"},
    {"SIMULATED", "values are made up by a simulated drive"},
    {"reconnecting", "the baseband manager does not answer; the values shown are the last ones received"},
    {"failed", "events whose payload could not be decoded"},
    {"lost", "events that the manager dropped because this program was too slow"},
    {"gaps", "times the manager was lost and found again; what passed between is unknown"},
    {"12:34:56 3s", "when the last event came, and how long ago"},
    {"/s", "events per second over the last seconds"},
}};

}  // namespace

std::vector<HelpLine> helpLines(int width, bool utf8) {
  std::vector<HelpLine> lines;
  const int room = std::max(width - helpTextColumn, 8);
  for (const Entry& entry : entries) {
    if (entry.text == nullptr) {
      if (!lines.empty()) lines.push_back({});
      lines.push_back({glyphsOf(entry.key, utf8), {}, true});
      continue;
    }
    bool first = true;
    for (GlyphLine& line : wrapped(glyphsOf(entry.text, utf8), room, room)) {
      const char* key = entry.key[0] == '>' && utf8 ? "›" : entry.key;
      lines.push_back({first ? glyphsOf(key, utf8) : GlyphLine(), std::move(line), false});
      first = false;
    }
  }
  return lines;
}

}  // namespace vespscope::terminal
