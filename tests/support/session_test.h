// Shared test support: running code that may leave through ExitToSession.
#pragma once

#include <csetjmp>

#include "duduzu/session.h"

// Runs f with RestartSession armed; true when f left through ExitToSession.
// f must not hold objects with destructors across the exit.
template <class F>
bool ExitsToSession(F f) {
  if (setjmp(RestartSession) != 0) return true;
  f();
  return false;
}
