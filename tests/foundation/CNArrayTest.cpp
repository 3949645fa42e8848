#include "foundation/CNArray.h"

#include <memory>

#include "support/TestFolder.h"

using Lines = std::vector<std::string>;

namespace {

// Counts how many of its kind live.
struct Counted {
  static inline int nLive = 0;
  Counted() { nLive++; }
  ~Counted() { nLive--; }
};

std::string Text(const char* szElement) { return szElement; }
std::string Text(const CNString* pElement) { return pElement->Text(); }

template <class Array>
Lines Texts(const Array& array) {
  Lines texts;
  for (int i = 0; i < array.Size(); i++) texts.push_back(Text(array[i]));
  return texts;
}

}  // namespace

TEST(CNArray, KeepsOrderThroughInsertAndRemove) {
  const auto pA = std::make_unique<int>(), pB = std::make_unique<int>(), pC = std::make_unique<int>();
  int *const a = pA.get(), *const b = pB.get(), *const c = pC.get();
  CNArray<int> array, both;
  array.Add(a, 0);
  array.Insert(c, 1);
  array.Insert(b, 1);
  both.Add(&array);
  both.Add(&both);  // itself: twice
  ASSERT_EQ(both.Size(), 6);
  const int* expected[] = {a, b, c, a, b, c};
  for (int i = 0; i < 6; i++) EXPECT_EQ(both[i], expected[i]);
  both.Remove(a);
  EXPECT_EQ(both.Find(a), 2) << "only the first slot goes";
  EXPECT_TRUE(both.Find(c) == 1 && !both[-1] && !both[5]);
  both.RemoveAll();
  EXPECT_TRUE(both.Size() == 0 && !both[0]);
}

TEST(CNArray, TheLastAddDecidesWhoOwns) {
  {
    Counted kept;
    CNArray<Counted> array;
    array.Add(new Counted, 0);
    array.Add(&kept, 0);
    array.Remove(&kept);
    array.Add(nullptr, 1);  // refused, but the flag counts
    Counted* const pInserted = new Counted;
    array.Insert(pInserted, 0);
    EXPECT_EQ(Counted::nLive, 3);
    array.Remove(pInserted);
    EXPECT_EQ(Counted::nLive, 2);
  }
  EXPECT_EQ(Counted::nLive, 0);
}

TEST(TextArrays, SplitInPlace) {
  const struct {
    const char *szText, *szSeparator;
    bool bUnique;
    Lines pieces;
  } rows[] = {
      {"a;b;;c;", ";", false, {"a", "b", "", "c"}},
      {"a;b;a", ";", true, {"a", "b"}},
      {";", ";", false, {""}},
      {"", ";", false, {}},
      {"x, y,z, ", ", ", false, {"x", "y,z"}},
      {"x, y, x", ", ", true, {"x", "y"}},
  };
  for (const auto& row : rows) {
    CNString csText(row.szText, 0), csOther(row.szText, 0);
    CNCharArray chars;
    EXPECT_EQ(chars.Set(csText.Ptr(), row.szSeparator, row.bUnique), 0);
    EXPECT_EQ(Texts(chars), row.pieces) << row.szText;
    if (row.szSeparator[1]) continue;
    CNStringArray strings;
    EXPECT_EQ(strings.Set(csOther.Ptr(), row.szSeparator[0], row.bUnique), 0);
    EXPECT_EQ(Texts(strings), row.pieces) << row.szText;
  }
}

TEST(TextArrays, HoldCopiesThatTheyOwn) {
  char szText[] = "first";
  CNCharArray chars;
  CNStringArray strings, more;
  chars.Add(szText, 1);
  strings.Add(szText, 1);
  strings.Add(CNString(szText, 7), 1);
  szText[0] = 'F';
  strings.Add("", 1);
  strings.Add("last", 1);
  EXPECT_EQ(Texts(chars), (Lines{"first"}));
  EXPECT_EQ(Texts(strings), (Lines{"first", "first", "", "last"}));
  int iModes[2] = {};
  for (int i = 0; i < 2; i++) strings[i]->iGetMode(&iModes[i]);
  EXPECT_TRUE(iModes[0] == -1 && iModes[1] == 7);
  EXPECT_EQ(strings.Find("last"), 3);
  EXPECT_EQ(strings.Find("Last"), -1);
  strings.Remove("first");
  EXPECT_EQ(Texts(strings), (Lines{"first", "", "last"}));
  more.Add(strings, 1);  // empty texts are left out
  more.Add(more, 1);
  EXPECT_EQ(Texts(more), (Lines{"first", "last", "first", "last"}));
}
