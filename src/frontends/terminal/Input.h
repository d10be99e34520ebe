// A user's input at the terminal, independent of the terminal's encoding.
#pragma once

namespace vespscope::terminal {

enum class Key {
  character,  // `character` says which
  pasted,     // `character` of a text that the user pasted: text only, whatever it means as a key
  up,
  down,
  left,
  right,
  pageUp,
  pageDown,
  home,
  end,
  enter,
  escape,
  backspace,
  click,  // the first mouse button, at `column` and `line`
  wheelUp,
  wheelDown,
};

struct Input {
  Key key = Key::character;
  char32_t character = 0;  // control characters as themselves: Ctrl-L is 12
  int column = 0;
  int line = 0;
};

}  // namespace vespscope::terminal
