#include "platform/log/Log.h"

#include <syslog.h>
#include <unistd.h>

#include <algorithm>
#include <atomic>
#include <cerrno>
#include <cstdlib>
#include <memory>
#include <mutex>
#include <utility>
#include <vector>

#include "platform/log/DivertedSystemLog.h"
#include "platform/log/SystemLogWriter.h"
#include "values/Text.h"

namespace vespscope::log {
namespace {

template <class Callback>
struct Registered {
  std::uint64_t identifier;
  std::shared_ptr<Callback> callback;
};

using Observers = std::vector<Registered<Observer>>;

constexpr std::size_t outputBlock = 16384;  // bytes written to standard output at once

struct Router {
  std::mutex mutex;
  // Replaced as a whole, never changed, so that a logging thread takes it without copying; null without observers.
  std::shared_ptr<const Observers> observers;
  std::atomic<std::uint64_t> observersVersion = 0;  // incremented with each replacement
  std::atomic<bool> observed = false;
  std::vector<Registered<std::function<void()>>> fatalHooks;
  std::uint64_t lastIdentifier = 0;
  std::atomic<bool> terminalOwned = false;
  std::atomic<bool> outputHidden = false;  // a frontend draws on the terminal of standard output
  std::atomic<bool> discarded = false;
  std::mutex outputMutex;  // keeps lines of standard output whole and in order
  std::string output;      // gathered and not yet written
  std::size_t batches = 0;
  std::atomic<std::uint64_t> outputFailures = 0;
  SystemLogWriter writer;
};

// Never destroyed: lines may still be logged while the process exits.
Router& router() {
  static Router* shared = new Router;
  return *shared;
}

void setObservers(Router& shared, Observers observers) {
  shared.observed = !observers.empty();
  shared.observers = observers.empty() ? nullptr : std::make_shared<const Observers>(std::move(observers));
  ++shared.observersVersion;
}

Observers observersOf(const Router& shared) { return shared.observers == nullptr ? Observers() : *shared.observers; }

void tellObservers(Channel channel, std::string_view line) {
  Router& shared = router();
  if (!shared.observed) return;
  // Each thread caches the observers and fetches them again only after a change.
  struct Known {
    std::uint64_t version = 0;
    std::shared_ptr<const Observers> observers;  // null while they are being called
  };
  thread_local Known known;
  if (known.observers == nullptr || shared.observersVersion != known.version) {
    const std::lock_guard lock(shared.mutex);
    known = {shared.observersVersion, shared.observers};
  }
  if (known.observers == nullptr) return;
  // An observer may log, and may be added or removed meanwhile. The list is moved out during the calls, not shared:
  // reference counting would cost as much as the calls.
  const std::uint64_t version = known.version;
  std::shared_ptr<const Observers> observers = std::move(known.observers);
  for (const auto& entry : *observers) (*entry.callback)(channel, line);
  if (known.observers == nullptr && known.version == version) known.observers = std::move(observers);
}

// Returns the line itself if it is printable, as nearly all are, else its printable form, which `clean` then holds.
std::string_view madePrintable(std::string_view line, std::string& clean) {
  if (isPlain(line)) return line;
  appendPrintable(clean, line);
  return clean;
}

bool writeAll(int descriptor, std::string_view text) {
  while (!text.empty()) {
    const ssize_t written = ::write(descriptor, text.data(), text.size());
    if (written < 0 && errno == EINTR) continue;
    if (written < 0) return false;
    text.remove_prefix(static_cast<std::size_t>(written));
  }
  return true;
}

// The caller holds outputMutex.
void writeOutput(Router& shared) {
  if (shared.output.empty()) return;
  if (!writeAll(STDOUT_FILENO, shared.output)) ++shared.outputFailures;
  shared.output.clear();
}

// Receives this thread's lines for the system log; null as long as they are logged.
thread_local const DivertedSystemLog::Lines* diverted = nullptr;

}  // namespace

DivertedSystemLog::DivertedSystemLog(const Lines& lines) : outer_(std::exchange(diverted, &lines)) {}
DivertedSystemLog::~DivertedSystemLog() { diverted = outer_; }

void system(std::string_view line) {
  if (diverted != nullptr) {
    if (*diverted) (*diverted)(line);
    return;
  }
  Router& shared = router();
  if (shared.discarded && !shared.observed) return;
  std::string clean;
  const std::string_view text = madePrintable(line, clean);
  tellObservers(Channel::systemLog, text);
  if (!shared.discarded) shared.writer.enqueue(text, shared.terminalOwned);
}

void print(std::string_view line) {
  Router& shared = router();
  if (shared.discarded && !shared.observed) return;
  std::string clean;
  const std::string_view text = madePrintable(line, clean);
  tellObservers(Channel::standardOutput, text);
  if (shared.discarded) return;
  if (shared.outputHidden) return;
  const std::lock_guard lock(shared.outputMutex);
  shared.output += text;
  shared.output += '\n';
  if (shared.batches == 0 || shared.output.size() >= outputBlock) writeOutput(shared);
}

OutputBatch::OutputBatch() {
  const std::lock_guard lock(router().outputMutex);
  ++router().batches;
}

OutputBatch::~OutputBatch() {
  Router& shared = router();
  const std::lock_guard lock(shared.outputMutex);
  if (--shared.batches == 0) writeOutput(shared);
}

Observation::Observation(Observer observer) {
  Router& shared = router();
  const std::lock_guard lock(shared.mutex);
  Observers observers = observersOf(shared);
  identifier_ = ++shared.lastIdentifier;
  observers.push_back({identifier_, std::make_shared<Observer>(std::move(observer))});
  setObservers(shared, std::move(observers));
}

Observation::~Observation() {
  Router& shared = router();
  const std::lock_guard lock(shared.mutex);
  Observers observers = observersOf(shared);
  std::erase_if(observers, [this](const auto& entry) { return entry.identifier == identifier_; });
  setObservers(shared, std::move(observers));
}

FatalHook::FatalHook(std::function<void()> hook) {
  Router& shared = router();
  const std::lock_guard lock(shared.mutex);
  identifier_ = ++shared.lastIdentifier;
  shared.fatalHooks.push_back({identifier_, std::make_shared<std::function<void()>>(std::move(hook))});
}

FatalHook::~FatalHook() {
  Router& shared = router();
  const std::lock_guard lock(shared.mutex);
  std::erase_if(shared.fatalHooks, [this](const auto& entry) { return entry.identifier == identifier_; });
}

void setTerminalOwned(bool owned) {
  router().terminalOwned = owned;
  router().outputHidden = owned && ::isatty(STDOUT_FILENO) != 0;
}
void discardOutputs(bool discard) { router().discarded = discard; }
void flush() { router().writer.flush(); }
Counters counters() { return {router().writer.dropped(), router().outputFailures}; }

void fatal(std::string_view what, std::source_location where) {
  // If a hook fails, the hooks do not run again.
  static std::atomic<bool> stopping = false;
  Router& shared = router();
  if (!stopping.exchange(true)) {
    std::vector<Registered<std::function<void()>>> hooks;
    {
      const std::lock_guard lock(shared.mutex);
      hooks = shared.fatalHooks;
    }
    std::reverse(hooks.begin(), hooks.end());
    for (const auto& hook : hooks) (*hook.callback)();
  }
  const std::string_view path = where.file_name();
  const std::string line =
      printable("fatal: " + std::string(what) + " (" + std::string(path.substr(path.find_last_of('/') + 1)) + ":" +
                std::to_string(where.line()) + ")");
  // This is the last line: earlier lines are written first, and nothing more is queued.
  shared.discarded = true;
  if (const std::unique_lock lock(shared.outputMutex, std::try_to_lock); lock) writeOutput(shared);
  shared.writer.flush();
  if (SystemLogWriter::daemonPresent()) ::syslog(LOG_CRIT, "%s", line.c_str());
  writeAll(STDERR_FILENO, line + "\n");
  std::abort();
}

}  // namespace vespscope::log
