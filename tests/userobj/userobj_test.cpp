// Named user objects: attach/replace/detach, name order, deep copies, ownership.
#include <gtest/gtest.h>

#include <string>

#include "duduzu/userobj.h"

namespace {

int live = 0;       // TestObj instances alive
std::string shown;  // what PrintObj printed

// A tagged object; a copy adds "'" to the tag; it may refuse to be copied.
struct TestObj : Qel_UserObj {
  explicit TestObj(std::string t, bool canCopy = true) : tag(std::move(t)), copyable(canCopy) {
    ++live;
  }
  TestObj(const TestObj& o) : TestObj(o.tag + "'", o.copyable) {}
  ~TestObj() override { --live; }
  Qel_UserObj* CopyUserObj() override { return copyable ? new TestObj(*this) : nullptr; }
  void PrintObj(FILE*, const char* prefix) override { shown += prefix + tag + ";"; }
  std::string tag;
  bool copyable;
};

std::string print(const Qel_UserObjContainer& c) {
  shown.clear();
  c.PrintAttachedInfos(stdout, ">");
  return shown;
}

class UserObj : public ::testing::Test {
 protected:
  void TearDown() override { EXPECT_EQ(live, 0); }  // every object was released
};

TEST_F(UserObj, AttachKeepsOrReplacesAndDetachFreesTheInlineSlot) {
  Qel_UserObjContainer c;
  TestObj *a = new TestObj("A"), *b = new TestObj("B"), *y2 = new TestObj("Y2");
  EXPECT_EQ(c.AttachObj(a, "x", false), nullptr);
  EXPECT_EQ(c.AttachObj(b, "x", false), a);
  EXPECT_EQ(c.GetObj("x", false), a);
  EXPECT_EQ(c.AttachObj(b, "x", true), a);
  c.AttachObj(new TestObj("Y"), "y", false);
  EXPECT_EQ(c.GetObj("x", true), b);
  EXPECT_EQ(c.GetObj("x", false), nullptr);
  EXPECT_EQ(c.AttachObj(y2, "y", false), nullptr);  // inline, though "y" stands in the map
  EXPECT_EQ(c.GetObj("y", true), y2);
  EXPECT_EQ(print(c), ">Y;");
  delete a, delete b, delete y2;
}

TEST_F(UserObj, InlineFirstThenNamesInUnsignedByteOrderShorterFirst) {
  Qel_UserObjContainer c;
  for (const char* name : {"x", "b", "\xE9", "ab", "aB", "a"}) c.AttachObj(new TestObj(name), name, false);
  EXPECT_EQ(print(c), ">x;>a;>aB;>ab;>b;>\xE9;");
}

TEST_F(UserObj, CopyAllCopiesWhatCanBeCopiedAndReleasesWhatItReplaces) {
  Qel_UserObjContainer from, to, none;
  from.AttachObj(new TestObj("F1"), "i", false);
  from.AttachObj(new TestObj("F2"), "m", false);
  from.AttachObj(new TestObj("F3", false), "k", false);
  from.AttachObj(new Qel_UserObj, "p", false);
  to.AttachObj(new TestObj("T1"), "t", false);
  to.AttachObj(new TestObj("T2"), "m", false);
  to.CopyAllUserObjFrom(&none);
  to.CopyAllUserObjFrom(nullptr);  // ignored
  to.CopyAllUserObjFrom(&from);
  EXPECT_EQ(print(to), ">F1';>F2';");
  EXPECT_EQ(to.GetObj("t", false), nullptr);
  EXPECT_EQ(live, 5);
}

TEST_F(UserObj, CopiesAndAssignmentsAreDeep) {
  auto* source = new Qel_UserObjContainer;
  source->AttachObj(new TestObj("A"), "a", false);
  source->AttachObj(new TestObj("B"), "b", false);
  Qel_UserObjContainer copy(*source), assigned, none;
  assigned.AttachObj(new TestObj("old"), "o", false);
  assigned = *source;
  delete source;
  EXPECT_EQ(print(copy) + print(assigned), ">A';>B';>A';>B';");
  const Qel_UserObjContainer& same = assigned;
  assigned = same;
  assigned.CopyAllUserObjFrom(&assigned);
  EXPECT_EQ(print(assigned), ">A''';>B''';");
  copy = none;
  EXPECT_EQ(print(copy) + std::to_string(live), "2");
}

}  // namespace
