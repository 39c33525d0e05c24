// Named user objects: the base class, and the container with its inline first
// entry and the ordered map of further entries. Nothing here reports.
#include <algorithm>
#include <cstring>
#include <map>
#include <utility>

#include "duduzu/userobj.h"
#include "frame/unit.h"

namespace {

using Name = Port::StringBase<char>;

// Byte-wise order of the common prefix (bytes unsigned), the shorter name first.
struct NameLess {
  bool operator()(const Name& a, const Name& b) const {
    int c = memcmp(a.c_str(), b.c_str(), std::min(a.length(), b.length()));
    return c != 0 ? c < 0 : a.length() < b.length();
  }
};

using EntryMap = std::map<Name, Qel_UserObj*, NameLess>;

}  // namespace

struct Qel_UserObjContainer::Entries {
  Qel_UserObj* inlineObj = nullptr;  // owned; null when the inline slot is empty
  Name inlineName;
  EntryMap* others = nullptr;        // owned objects under further names

  // f on the inline object, then on each object of the map in name order.
  template <class F>
  void forEachObj(F f) const {
    if (inlineObj) f(inlineObj);
    if (!others) return;
    for (const auto& entry : *others)
      if (entry.second) f(entry.second);
  }
};

Qel_UserObj::~Qel_UserObj() = default;
Qel_UserObj* Qel_UserObj::CopyUserObj() { return nullptr; }
void Qel_UserObj::PrintObj(FILE*, const char*) {}

Qel_UserObjContainer::Qel_UserObjContainer() : entries_(nullptr) {}

Qel_UserObjContainer::Qel_UserObjContainer(const Qel_UserObjContainer& other)
    : entries_(nullptr) {
  copyFrom(other.entries_);
}

Qel_UserObjContainer& Qel_UserObjContainer::operator=(const Qel_UserObjContainer& other) {
  Qel_UserObjContainer copy(other);
  std::swap(entries_, copy.entries_);
  return *this;
}

Qel_UserObjContainer::~Qel_UserObjContainer() {
  if (!entries_) return;
  entries_->forEachObj([](Qel_UserObj* obj) { delete obj; });
  delete entries_->others;
  delete entries_;
}

Qel_UserObj* Qel_UserObjContainer::AttachObj(Qel_UserObj* obj, const Name& name, bool replace) {
  if (!entries_) entries_ = new Entries;
  Entries& e = *entries_;
  if (!e.inlineObj) {
    e.inlineObj = obj;
    e.inlineName = name;
    return nullptr;
  }
  Qel_UserObj** slot = &e.inlineObj;
  if (name != e.inlineName) {
    if (!e.others) e.others = new EntryMap;
    auto found = e.others->emplace(name, obj);
    if (found.second) return nullptr;
    slot = &found.first->second;
  }
  Qel_UserObj* old = *slot;
  if (replace) *slot = obj;
  return old;
}

Qel_UserObj* Qel_UserObjContainer::GetObj(const Name& name, bool detach) const {
  if (!entries_) return nullptr;
  Entries& e = *entries_;
  Qel_UserObj* obj = e.inlineObj;
  if (obj && name == e.inlineName) {
    if (detach) e.inlineObj = nullptr;  // the name stays until the slot is refilled
    return obj;
  }
  if (!e.others) return nullptr;
  auto found = e.others->find(name);
  if (found == e.others->end()) return nullptr;
  obj = found->second;
  if (detach) e.others->erase(found);
  return obj;
}

void Qel_UserObjContainer::CopyAllUserObjFrom(Qel_UserObjContainer* from) {
  if (from) copyFrom(from->entries_);
}

void Qel_UserObjContainer::copyFrom(const Entries* from) {
  if (!from) return;
  if (!entries_) entries_ = new Entries;
  Qel_UserObj* copy = from->inlineObj ? from->inlineObj->CopyUserObj() : nullptr;
  if (copy) {
    delete entries_->inlineObj;
    entries_->inlineObj = copy;
    entries_->inlineName = from->inlineName;
  }
  if (!from->others) return;
  if (!entries_->others) entries_->others = new EntryMap;
  for (const auto& entry : *from->others) {
    copy = entry.second ? entry.second->CopyUserObj() : nullptr;
    if (copy) delete AttachObj(copy, entry.first, true);
  }
}

void Qel_UserObjContainer::PrintAttachedInfos(FILE* out, const char* prefix) const {
  if (entries_) entries_->forEachObj([&](Qel_UserObj* obj) { obj->PrintObj(out, prefix); });
}
