// What every source unit of the library shares: its Portability initialisers,
// the reporting convention and the main-output rule.
//
// A unit defines `kUnit` (its source path for reports) before using DZ_REPORT
// or DZ_OUT.
#pragma once

#include <cstdio>

#include "duduzu/session.h"
#include "port/port.h"

namespace dz {

enum class Level { Status, Warning, Error, Fatal };

// Origin of every report: the library's module name and revision text.
constexpr const char* kModule = "DuduzuRorez";
constexpr const char* kRevision = "$Revision: 1.1 $";

#pragma GCC diagnostic push
#pragma GCC diagnostic ignored "-Wformat-security"
#pragma GCC diagnostic ignored "-Wformat-nonliteral"

// One report: a report object for (module, unit, line, revision), then one
// issue call with the format and arguments unchanged.
template <class... A>
void report(const char* unit, int line, Level level, const char* fmt, A... args) {
  Port_MsgManData* r =
      Port_MsgManData::createObject(kModule, unit, line, kRevision);
  switch (level) {
    case Level::Status: r->issueStatus(fmt, args...); break;
    case Level::Warning: r->issueWarning(fmt, args...); break;
    case Level::Error: r->issueError(fmt, args...); break;
    case Level::Fatal: r->issueFatal(1, fmt, args...); break;
  }
}

// Main-output rule: a write to MainEVarOutFile (compared as pointers, null
// included) becomes a status report; any other stream gets fprintf.
template <class... A>
void out(FILE* stream, const char* unit, int line, const char* fmt, A... args) {
  if (stream == MainEVarOutFile)
    report(unit, line, Level::Status, fmt, args...);
  else
    fprintf(stream, fmt, args...);
}

#pragma GCC diagnostic pop

}  // namespace dz

#define DZ_REPORT(level, ...) ::dz::report(kUnit, __LINE__, ::dz::Level::level, __VA_ARGS__)
#define DZ_OUT(stream, ...) ::dz::out(stream, kUnit, __LINE__, __VA_ARGS__)

namespace {
// The Portability initialisers of this unit, built at load in this order.
struct PortUnitInit {
  Port::FileInit file;
  Port::PathListInit pathList;
  InstanceTableInit instanceTable;
  FactoryInit factory;
  Port_MsgManInit msgMan;
};
const PortUnitInit portUnitInit;
}  // namespace
