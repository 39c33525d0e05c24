// Named user objects: attach/replace/detach, name order, deep copies, ownership.
#include <gtest/gtest.h>

#include <string>
#include <utility>

#include "duduzu/userobj.h"

namespace {

int live = 0;       // TestObj instances alive
std::string shown;  // what PrintObj printed

// A tagged object; its copy adds "'" to the tag.
struct TestObj : Qel_UserObj {
  explicit TestObj(std::string t) : tag(std::move(t)) { ++live; }
  ~TestObj() override { --live; }
  Qel_UserObj* CopyUserObj() override { return new TestObj(tag + "'"); }
  void PrintObj(FILE*, const char* prefix) override { shown += prefix + tag + ";"; }
  std::string tag;
};

std::string print(const Qel_UserObjContainer& c) {
  c.PrintAttachedInfos(stdout, ">");
  return std::exchange(shown, "");
}

struct UserObj : ::testing::Test {
  void TearDown() override { EXPECT_EQ(live, 0); }  // every object was released
};

TEST_F(UserObj, AttachKeepsOrReplacesDetachFreesTheInlineSlotAndNamesSortByByte) {
  Qel_UserObjContainer c, sorted;
  TestObj *a = new TestObj("A"), *b = new TestObj("B"), *y2 = new TestObj("Y2");
  EXPECT_EQ(c.AttachObj(a, "x", false), nullptr);
  EXPECT_EQ(c.AttachObj(b, "x", false), a);
  EXPECT_EQ(c.AttachObj(b, "x", true), a);  // a was kept by the first refusal
  c.AttachObj(new TestObj("Y"), "y", false);
  EXPECT_EQ(c.GetObj("x", true), b);
  EXPECT_EQ(c.AttachObj(y2, "y", false), nullptr);  // inline, though "y" stands in the map
  EXPECT_EQ(c.GetObj("y", true), y2);
  EXPECT_EQ(print(c), ">Y;");
  delete a, delete b, delete y2;
  // Inline first, then unsigned byte order, the shorter name first.
  for (const char* name : {"x", "b", "\xE9", "ab", "aB", "a"}) sorted.AttachObj(new TestObj(name), name, false);
  EXPECT_EQ(print(sorted), ">x;>a;>aB;>ab;>b;>\xE9;");
}

TEST_F(UserObj, CopiesAreDeepAndReleaseWhatTheyReplace) {
  Qel_UserObjContainer from, to;
  from.AttachObj(new TestObj("F1"), "i", false);
  from.AttachObj(new TestObj("F2"), "m", false);
  from.AttachObj(new Qel_UserObj, "p", false);  // the base class gives no copy
  to.AttachObj(new TestObj("T1"), "t", false);
  to.AttachObj(new TestObj("T2"), "m", false);
  to.CopyAllUserObjFrom(nullptr);  // ignored
  to.CopyAllUserObjFrom(&from);
  EXPECT_EQ(print(to) + std::to_string(live), ">F1';>F2';4");
  EXPECT_EQ(to.GetObj("t", false), nullptr);  // the inline entry took its name too
  Qel_UserObjContainer copy(from), assigned;
  assigned.AttachObj(new TestObj("old"), "o", false);
  assigned = from;
  EXPECT_EQ(print(copy) + print(assigned), ">F1';>F2';>F1';>F2';");
  assigned = static_cast<const Qel_UserObjContainer&>(assigned);
  assigned.CopyAllUserObjFrom(&assigned);
  EXPECT_EQ(print(assigned), ">F1''';>F2''';");
}

}  // namespace
