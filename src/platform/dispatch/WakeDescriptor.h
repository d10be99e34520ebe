// A descriptor that wakes a polling thread.
#pragma once

namespace vespscope::dispatch {

class WakeDescriptor {
 public:
  // Stops the program when the system has no descriptor left.
  WakeDescriptor();
  WakeDescriptor(const WakeDescriptor&) = delete;
  WakeDescriptor& operator=(const WakeDescriptor&) = delete;
  ~WakeDescriptor();

  // Readable from a wake() until the next clear().
  [[nodiscard]] int descriptor() const { return descriptor_; }
  // Safe from any thread and from a signal handler; keeps errno.
  void wake() const;
  // True when there was a wake() since the last clear().
  bool clear() const;

 private:
  const int descriptor_;
};

}  // namespace vespscope::dispatch
