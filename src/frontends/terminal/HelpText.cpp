#include "frontends/terminal/HelpText.h"

#include <algorithm>
#include <array>

namespace vespscope::terminal {
namespace {

struct Entry {
  const char* key;  // without text: a group title
  const char* text;
};

constexpr std::array<Entry, 36> entries = {{
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
    {"/", "filter rows by label, value or section, or log lines; enter keeps the filter, esc clears it"},
    {"r", "read the values again now"},
    {"s", "show the phone's other SIM card, when several report"},
    {"y, Y", "copy the row, the whole screen to the clipboard, where the terminal supports it (OSC 52)"},
    {"l", "log: the last lines of system log (sys) and output (out)"},
    {"?", "this help"},
    {"Ctrl-L", "draw the whole screen again"},
    {"Ctrl-Z", "suspend"},
    {"q, Ctrl-C", "quit"},
    {"Marks", nullptr},
    {"*", "the value changed, or the row is new, since the screen was read before"},
    {">", "selecting the row opens another screen"},
    {"updated 3 s ago", "when the values shown were reported; amber: a measurement is out of date"},
    {"last known", "nothing reports these values any more: the phone uses another technology, or the manager is gone"},
    {"Status line", nullptr},
    {"LIVE", "values come from a modem at this moment"},
    {"PLAYBACK", "values come from a recording"},
    {"SIMULATED", "values are made up by a simulated drive"},
    {"SIM 1", "the SIM card whose values are shown; (also SIM 2) when another one reports"},
    {"reconnecting", "the baseband manager does not answer; the values shown are the last ones received"},
    {"not subscribed", "the baseband manager is connected but sends no events; the reason stands beside it"},
    {"end of recording", "the recording has been played to its end"},
    {"decode failures", "events whose payload could not be decoded"},
    {"lost", "events that the manager dropped because this program was too slow"},
    {"gaps", "times the connection was lost and made again; how many events are missing is unknown"},
    {"12:34:56 3s", "when the last event came, and how long ago; in playback the recording's own clock"},
    {"01:37/02:03", "the position in a recording, its length, and its speed unless it is 1 (x10)"},
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
