// Test facilities of the Portability stand-in: report capture and allocation
// failure injection.
#pragma once

#include <string>
#include <vector>

#include "port/port.h"

namespace PortTest {

// Records every report made while it lives, whichever managers are installed.
class PORT_API Capture {
 public:
  Capture();
  ~Capture();
  Capture(const Capture&) = delete;
  Capture& operator=(const Capture&) = delete;

  const std::vector<Port_Report>& reports() const { return reports_; }
  size_t size() const { return reports_.size(); }
  const Port_Report& operator[](size_t i) const { return reports_[i]; }
  const Port_Report& last() const { return reports_.back(); }
  // Concatenated text of every report of the level (all levels when level < 0).
  std::string text(int level = -1) const;
  void clear() { reports_.clear(); }

  void record(const Port_Report& report) { reports_.push_back(report); }

 private:
  std::vector<Port_Report> reports_;
};

// Makes the nth vzl_malloc/vzl_calloc/vzl_realloc from now (1 = the next) return null.
PORT_API void FailNthAlloc(long n);
// Makes every allocation from now return null.
PORT_API void FailAllAllocs();
// Ends any injected failure.
PORT_API void ResetAllocFailures();
// Number of vzl allocations since the process started (successful or not).
PORT_API long AllocCount();

// Scoped form: failures are reset when it goes out of scope.
struct AllocFailureGuard {
  AllocFailureGuard() = default;
  ~AllocFailureGuard() { ResetAllocFailures(); }
};

}  // namespace PortTest
