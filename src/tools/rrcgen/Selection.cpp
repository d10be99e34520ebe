#include "rrcgen/Selection.h"

#include <sstream>

namespace vespscope::rrcgen {

Result<Selection> parseSelection(const std::string& file, const std::string& text) {
  Selection selection;
  std::istringstream lines(text);
  std::string line;
  for (int number = 1; std::getline(lines, line); ++number) {
    std::istringstream content(line.substr(0, line.find('#')));
    std::vector<std::string> words;
    for (std::string word; content >> word;) words.push_back(word);
    if (words.empty()) continue;
    if (words[0] == "pdu" && words.size() == 4) {
      selection.pdus.push_back({words[1], {words[2], words[3]}});
    } else if (words[0] == "content" && words.size() == 5) {
      selection.contents.push_back({words[1], words[2], {words[3], words[4]}});
    } else {
      return Failure{file + ":" + std::to_string(number) +
                     ": expected 'pdu NAME MODULE TYPE' or 'content MODULE FIELD MODULE TYPE'"};
    }
  }
  if (selection.pdus.empty()) return Failure{file + ": no line 'pdu NAME MODULE TYPE'"};
  return selection;
}

}  // namespace vespscope::rrcgen
