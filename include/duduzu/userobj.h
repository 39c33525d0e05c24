// Named user objects: objects a tool hangs on its own data objects by name,
// copied and printed along with them.
#pragma once

#include <cstdio>

#include "duduzu/export.h"
#include "port/port.h"

// Base class of everything that can be attached to a container. It has no state.
class DUDUZU_API Qel_UserObj {
 public:
  Qel_UserObj() = default;
  Qel_UserObj(const Qel_UserObj&) = default;
  Qel_UserObj& operator=(const Qel_UserObj&) = default;
  virtual ~Qel_UserObj();
  // A new copy owned by the caller, or null when the object cannot be copied
  // (the base class).
  virtual Qel_UserObj* CopyUserObj();
  // Prints the object's information to out; the base class prints nothing.
  virtual void PrintObj(FILE* out, const char* prefix);
};

// Owns the objects attached to it under names (equal when length and bytes are
// equal). The first entry is held inline; an ordered map, by bytes with the
// shorter name first, is created only for further names.
class DUDUZU_API Qel_UserObjContainer {
 public:
  Qel_UserObjContainer();
  // Copies are deep: every object is copied through CopyUserObj (objects that
  // cannot be copied are left out).
  Qel_UserObjContainer(const Qel_UserObjContainer& other);
  Qel_UserObjContainer& operator=(const Qel_UserObjContainer& other);
  virtual ~Qel_UserObjContainer();

  // Null when obj was added under a new name. Otherwise the object already
  // standing under name: with replace, obj takes its place and the returned
  // object passes to the caller; without, nothing changes and obj stays with
  // the caller.
  Qel_UserObj* AttachObj(Qel_UserObj* obj, const Port::StringBase<char>& name, bool replace);
  // The object under name, or null; with detach it is removed and passes to
  // the caller.
  Qel_UserObj* GetObj(const Port::StringBase<char>& name, bool detach) const;
  // Adds a copy of each of from's objects, replacing same-named ones.
  void CopyAllUserObjFrom(Qel_UserObjContainer* from);
  // PrintObj on the inline object, then on the others in name order.
  void PrintAttachedInfos(FILE* out, const char* prefix) const;

 private:
  struct Entries;
  void copyFrom(const Entries* from);
  Entries* entries_;  // null until the first attach or copy into it
};
