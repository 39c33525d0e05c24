// System services: command processor, working directory, environment,
// temporary directory, process number, memory use, rounding and byte-reversed
// binary items.
#include <unistd.h>

#include <algorithm>
#include <cstdlib>
#include <cstring>
#include <ctime>

#include "duduzu/system.h"
#include "frame/unit.h"

namespace {

constexpr const char* kUnit = "../s/system";
constexpr size_t kPathSize = 1024;

// The working directory in buf; empty when it cannot be read (removed, or too
// long for the buffer).
const char* currentDir(char (&buf)[kPathSize]) { return getcwd(buf, sizeof buf) ? buf : ""; }

long long timeClock() { return static_cast<long long>(time(nullptr)); }

SystemClockFn readClock = timeClock;
int processNumber = 0;  // 0 until SystemGetPID computes it

// Runs use(buffer) with room for one item of size bytes: on the stack up to
// 16 bytes, on the heap beyond; 0 when that memory is out.
template <class Use>
int withItemBuffer(unsigned size, Use use) {
  char local[16];
  char* buffer = size <= sizeof local ? local : static_cast<char*>(vzl_malloc(size));
  if (!buffer) return 0;
  int result = use(buffer);
  if (buffer != local) vzl_free(buffer);
  return result;
}

}  // namespace

void SystemCmd(const char* cmd) {
  int ignored = system(cmd);
  (void)ignored;
}

int SystemCd(FILE* f, const char* dir) {
  char buf[kPathSize];
  // A name too long for the directory buffer counts as a failed change.
  if (!dir || strlen(dir) >= sizeof buf || chdir(dir) != 0) {
    if (f == MainEVarOutFile)
      DZ_REPORT(Error, "Cannot change Dir, Dir not changed\n");
    else
      fprintf(f, "Error - Cannot change Dir, Dir not changed\n");
  }
  DZ_OUT(f, "Current Dir is : %s\n", currentDir(buf));
  return 1;
}

int SystemPwd(FILE* f) {
  char buf[kPathSize];
  DZ_OUT(f, "%s\n", currentDir(buf));
  return 1;
}

char* SystemGetEnv(const char* name) { return name ? getenv(name) : nullptr; }

char* SystemGetTempPath(void) {
  char* path = static_cast<char*>(vzl_calloc(kPathSize, 1));
  if (!path) return nullptr;
  const char* dir = getenv("TMPDIR");
  if (!dir || !*dir) dir = "/tmp";
  const char* slash = dir[strlen(dir) - 1] == '/' ? "" : "/";
  if (static_cast<size_t>(snprintf(path, kPathSize, "%s%s", dir, slash)) >= kPathSize) path[0] = '\0';
  return path;
}

int SystemGetPID(void) {
  if (processNumber == 0) processNumber = static_cast<int>(readClock() / 10 % 1000) + 1;
  return processNumber;
}

void SystemSetClock(SystemClockFn clock) { readClock = clock ? clock : timeClock; }

long SystemGetHostId(void) { return 1; }

void SystemSetDebugMode(FILE*, int) {}

unsigned int SystemMemoryGet(void) { return UT_MEMORY::getMemoryUsage(); }

void SystemMemoryPrint(FILE* f, char* label) { DZ_OUT(f, "\n%s : %u\n", label, SystemMemoryGet()); }

int SystemIRint(float x) {
  double d = x;
  int i = static_cast<int>(d);
  if (d >= 0) return static_cast<int>(d + 0.5) > i ? i + 1 : i;
  return static_cast<int>(d - 0.5) < i ? i - 1 : i;
}

void SystemFWrite(char* data, unsigned size, unsigned n, FILE* f) {
  if (size == 1) {
    fwrite(data, 1, n, f);
    return;
  }
  withItemBuffer(size, [&](char* buffer) {
    for (unsigned i = 0; i < n; ++i, data += size) {
      std::reverse_copy(data, data + size, buffer);
      fwrite(buffer, size, 1, f);
    }
    return 0;
  });
}

int SystemFRead(char* data, unsigned size, unsigned n, FILE* f) {
  if (size == 1) return static_cast<int>(fread(data, 1, n, f));
  return withItemBuffer(size, [&](char* buffer) {
    unsigned read = 0;
    for (; read < n; ++read, data += size) {
      if (fread(buffer, size, 1, f) != 1) return 0;  // earlier items stay stored
      std::reverse_copy(buffer, buffer + size, data);
    }
    return static_cast<int>(read);
  });
}
