// Streams, environment, memory statistics, allocator with failure injection,
// initialiser classes.
#include <unistd.h>

#include <cstdio>
#include <cstdlib>

#include "port/port.h"
#include "port/port_testing.h"

// ---- streams ----

void Port::Stream::write(const std::string& text) {
  fwrite(text.data(), 1, text.size(), fp_);
  fflush(fp_);
}

Port::Stream* Port::File::open(const char* path, int access, bool binary) {
  if (!path) return nullptr;
  const char* mode = access == 6 ? (binary ? "ab" : "a") : (binary ? "wb" : "w");
  FILE* fp = fopen(path, mode);
  return fp ? new Port::Stream(fp) : nullptr;
}

void Port::File::close(Port::Stream* stream) {
  if (!stream || stream == getCout()) return;
  fclose(stream->handle());
  delete stream;
}

Port::Stream* Port::File::getCout() {
  static Port::Stream* console = new Port::Stream(stdout);
  return console;
}

// ---- environment and memory ----

const char* Port_Env::GetEnv(const char* name) { return name ? getenv(name) : nullptr; }

unsigned UT_MEMORY::getMemoryUsage() {
  unsigned long pages = 0, resident = 0;
  FILE* fp = fopen("/proc/self/statm", "r");
  if (!fp) return 0;
  if (fscanf(fp, "%lu %lu", &pages, &resident) != 2) resident = 0;
  fclose(fp);
  return static_cast<unsigned>(resident * static_cast<unsigned long>(sysconf(_SC_PAGESIZE)));
}

// ---- allocator ----

namespace {
long g_allocs = 0;     // allocation calls so far
long g_failAt = 0;     // allocation number that fails once (0: none)
bool g_failAll = false;

bool injectFailure() {
  ++g_allocs;
  if (__builtin_expect(!g_failAll && g_failAt == 0, 1)) return false;
  if (g_failAll) return true;
  if (g_allocs == g_failAt) {
    g_failAt = 0;
    return true;
  }
  return false;
}
}  // namespace

extern "C" {
void* vzl_malloc(size_t size) { return injectFailure() ? nullptr : malloc(size); }
void* vzl_calloc(size_t count, size_t size) {
  return injectFailure() ? nullptr : calloc(count, size);
}
void* vzl_realloc(void* block, size_t size) {
  return injectFailure() ? nullptr : realloc(block, size);
}
void vzl_free(void* block) { free(block); }
}

namespace PortTest {
void FailNthAlloc(long n) {
  g_failAll = false;
  g_failAt = n > 0 ? g_allocs + n : 0;
}
void FailAllAllocs() { g_failAll = true; }
void ResetAllocFailures() {
  g_failAll = false;
  g_failAt = 0;
}
long AllocCount() { return g_allocs; }
}  // namespace PortTest

// ---- initialisers: nothing to set up in the stand-in ----

Port::FileInit::FileInit() {}
Port::FileInit::~FileInit() {}
Port::PathListInit::PathListInit() {}
Port::PathListInit::~PathListInit() {}
InstanceTableInit::InstanceTableInit() {}
InstanceTableInit::~InstanceTableInit() {}
FactoryInit::FactoryInit() {}
FactoryInit::~FactoryInit() {}
Port_MsgManInit::Port_MsgManInit() {}
Port_MsgManInit::~Port_MsgManInit() {}
