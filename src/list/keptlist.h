// Lists that the library keeps from call to call: the open files, the names to
// clean up, the parameter defaults, the redirection stacks.
#pragma once

#include "duduzu/list.h"

// ListKill ends every list record at once. Each kept list is registered at load
// and released by ListKill first (its elements with `freeElt`, when given), so
// the end-of-session releases are safe in any order and leave nothing behind.
class KeptList {
 public:
  explicit KeptList(ListFreeFn freeElt = nullptr);
  KeptList(const KeptList&) = delete;
  KeptList& operator=(const KeptList&) = delete;

  DomList*& get() { return list_; }

  // Releases every kept list; called by ListKill before the record pool goes.
  static void releaseAll();

 private:
  DomList* list_ = nullptr;
  ListFreeFn freeElt_;
  KeptList* next_;
};
