// Searches a stream for its SIM card files on its own thread, once for all queries that arrive meanwhile.
#pragma once

#include <condition_variable>
#include <memory>
#include <mutex>
#include <stop_token>
#include <vector>

#include "sources/playback/Source.h"

namespace vespscope::sources {

class SimCardSearch {
 public:
  // `stream` must outlive the search.
  explicit SimCardSearch(EventStream& stream) : stream_(stream) {}
  SimCardSearch(const SimCardSearch&) = delete;
  SimCardSearch& operator=(const SimCardSearch&) = delete;
  ~SimCardSearch() { stop(); }

  // Passes the files to `found`: before it returns if they are found quickly, else later on the search's thread.
  void find(SimCardFilesHandler found);
  // Drops the waiting queries permanently. Returns when the stream is no longer used.
  void stop();

 private:
  // Shared with a detached thread, which ends with the search, usually long before this object.
  struct Shared {
    std::mutex mutex;
    std::condition_variable ended;
    bool running = false;  // the thread may use the stream
    std::stop_source stop;
    std::vector<SimCardFilesHandler> waiting;
  };
  static void run(Shared& shared, EventStream& stream);

  EventStream& stream_;
  const std::shared_ptr<Shared> shared_ = std::make_shared<Shared>();
};

}  // namespace vespscope::sources
