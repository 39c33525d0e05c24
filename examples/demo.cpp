// A short tour: lists printed to a stream and through the main-output rule,
// a fatal report, and a fatal condition unwinding to the session loop.
#include <csetjmp>
#include <cstdint>
#include <cstdio>

#include "duduzu/duduzu.h"
#include "port/port_testing.h"

static void printInt(FILE* stream, int* e) {
  fprintf(stream, "%d", static_cast<int>(reinterpret_cast<intptr_t>(e)));
}

int main() {
  if (setjmp(RestartSession) != 0) {
    PortTest::ResetAllocFailures();
    printf("session loop: return status %d\n", MainEVarReturnStatus);
    ListKill();
    return 0;
  }
  DomList* list = ListCreate();
  for (intptr_t i = 1; i <= 5; ++i) ListAddElt(list, reinterpret_cast<int*>(i * i));
  printf("squares: ");
  ListPrint(stdout, list, printInt, ", ");
  printf("\n");

  ListDelShift(list, 2);
  MainEVarOutFile = stdout;  // separators now go out as status reports
  printf("after removing position 2: ");
  ListPrint(stdout, list, printInt, " | ");
  printf("\n");

  printf("a bad index is a fatal report that returns:\n");
  fflush(stdout);
  ListDelShift(list, 42);

  printf("a list that cannot grow ends the session:\n");
  fflush(stdout);
  PortTest::FailAllAllocs();  // simulate exhausted memory
  for (int i = 0; i < 100; ++i) ListAddElt(list, nullptr);
  return 1;
}
