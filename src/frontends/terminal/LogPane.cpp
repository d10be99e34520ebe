#include "frontends/terminal/LogPane.h"

#include <algorithm>

#include "platform/application/ClockText.h"

namespace vespscope::terminal {
namespace {

constexpr int widthForTimes = 60;  // below this width, the times are left out
constexpr int hang = 2;            // indent of a line's continuation

int prefixWidth(int width) { return width >= widthForTimes ? 14 : 4; }

const char* nameOf(log::Channel channel) { return channel == log::Channel::systemLog ? "sys" : "out"; }

}  // namespace

void LogPane::add(std::deque<LogLine> lines) {
  for (LogLine& line : lines) {
    if (filter_.passes(line.text)) listed_.push_back(line.number);
    lines_.push(std::move(line));
  }
  while (!listed_.empty() && listed_.front() < lines_.front().number) listed_.pop_front();
}

void LogPane::setFilter(std::string filter) {
  if (filter == filter_.text()) return;
  filter_ = application::TextFilter(std::move(filter));
  listed_.clear();
  for (const LogLine& line : lines_) {
    if (filter_.passes(line.text)) listed_.push_back(line.number);
  }
}

std::vector<GlyphLine> LogPane::broken(const LogLine& line, int width, bool utf8) const {
  const int room = std::max(width - prefixWidth(width), 4);
  return wrapped(glyphsOf(line.text, utf8), room, room - hang);
}

int LogPane::heightOf(std::size_t listed, int width, bool utf8) const {
  const LogLine& line = lines_[static_cast<std::size_t>(listed_.at(listed) - lines_.front().number)];
  return static_cast<int>(broken(line, width, utf8).size());
}

LogPane::Position LogPane::lastTop(Size view, bool utf8) const {
  int left = view.height;
  std::size_t listed = listed_.size();
  while (listed > 0 && left > 0) left -= heightOf(--listed, view.width, utf8);
  return {listed, std::max(-left, 0)};
}

LogPane::Position LogPane::top(Size view, bool utf8) const {
  const Position last = lastTop(view, utf8);
  if (follows_) return last;
  const auto found = std::lower_bound(listed_.begin(), listed_.end(), topNumber_);
  Position wanted{static_cast<std::size_t>(found - listed_.begin()), 0};
  if (found != listed_.end() && *found == topNumber_) {
    wanted.line = std::min(topLine_, heightOf(wanted.listed, view.width, utf8) - 1);
  }
  const bool beyond = wanted.listed > last.listed || (wanted.listed == last.listed && wanted.line > last.line);
  return beyond ? last : wanted;
}

void LogPane::scrollBy(int count, Size view, bool utf8) {
  if (listed_.empty()) return;
  Position at = top(view, utf8);
  const Position last = lastTop(view, utf8);
  for (; count < 0; ++count) {
    if (at.line > 0) {
      --at.line;
    } else if (at.listed > 0) {
      at.line = heightOf(--at.listed, view.width, utf8) - 1;
    }
  }
  for (; count > 0 && at.listed < listed_.size(); --count) {
    if (++at.line >= heightOf(at.listed, view.width, utf8)) at = {at.listed + 1, 0};
  }
  follows_ = at.listed > last.listed || (at.listed == last.listed && at.line >= last.line);
  if (follows_) return;
  topNumber_ = listed_.at(at.listed);
  topLine_ = at.line;
}

void LogPane::home() {
  follows_ = false;
  topNumber_ = 0;
  topLine_ = 0;
}

void LogPane::draw(Grid& grid, int topOfView, int height) {
  const Size view{grid.size().width, height};
  const Position first = top(view, grid.utf8());
  const int indent = prefixWidth(view.width);
  int y = topOfView;
  std::size_t listed = first.listed;
  for (; listed < listed_.size() && y < topOfView + height; ++listed) {
    const LogLine& line = lines_[static_cast<std::size_t>(listed_[listed] - lines_.front().number)];
    const auto pieces = broken(line, view.width, grid.utf8());
    for (std::size_t piece = listed == first.listed ? static_cast<std::size_t>(first.line) : 0;
         piece < pieces.size() && y < topOfView + height; ++piece, ++y) {
      if (piece == 0) {
        const std::string time = view.width >= widthForTimes ? application::timeOfDay(line.time) + " " : "";
        grid.put(0, y, time + nameOf(line.channel), {Role::faint});
      }
      grid.put(piece == 0 ? indent : indent + hang, y, pieces[piece]);
    }
  }
  below_ = listed_.size() - listed;
}

}  // namespace vespscope::terminal
