#include "foundation/CNArray.h"

#include "support/TestFolder.h"

using Lines = std::vector<std::string>;

namespace {

// Counts how many of its kind live.
struct Counted {
  static int nLive;
  Counted() { nLive++; }
  ~Counted() { nLive--; }
};
int Counted::nLive = 0;

template <class Array>
Lines Texts(const Array& array);
template <>
Lines Texts(const CNStringArray& array) {
  Lines texts;
  for (int i = 0; i < array.Size(); i++) texts.push_back(array[i]->Text());
  return texts;
}
template <>
Lines Texts(const CNCharArray& array) {
  Lines texts;
  for (int i = 0; i < array.Size(); i++) texts.push_back(array[i]);
  return texts;
}

}  // namespace

TEST(CNArray, KeepsOrderThroughInsertAndRemove) {
  int a, b, c, d;
  CNArray<int> array, both;
  array.Add(&a, 0);
  array.Insert(&c, 1);
  array.Insert(&b, 1);
  array.Insert(&d, 0);
  both.Add(&array);
  both.Add(&both);  // itself: twice
  ASSERT_EQ(both.Size(), 8);
  const int* expected[] = {&d, &a, &b, &c, &d, &a, &b, &c};
  for (int i = 0; i < 8; i++) EXPECT_EQ(both[i], expected[i]);
  both.Remove(&a);
  EXPECT_EQ(both.Size(), 7);
  EXPECT_EQ(both.Find(&a), 4) << "only the first slot goes";
  EXPECT_EQ(both.Find(&c), 2);
  EXPECT_EQ(both[-1], nullptr);
  EXPECT_EQ(both[7], nullptr);
  both.RemoveAll();
  EXPECT_EQ(both.Size(), 0);
  EXPECT_EQ(both[0], nullptr);
}

TEST(CNArray, TheLastAddDecidesWhoOwns) {
  {
    Counted kept;
    CNArray<Counted> array;
    array.Add(new Counted, 0);
    array.Add(&kept, 0);
    array.Remove(&kept);
    array.Add(nullptr, 1);  // refused, but the flag counts
    array.Add(new Counted, 1);
    Counted* const pThird = new Counted;
    array.Insert(pThird, 0);
    EXPECT_EQ(Counted::nLive, 4);
    array.Remove(pThird);
    EXPECT_EQ(Counted::nLive, 3);
  }
  EXPECT_EQ(Counted::nLive, 0);
}

TEST(CNArray, RefusalsLogAndChangeNothing) {
  TestFolder folder;
  TestLog log(folder);
  int a, b;
  CNArray<int> array;
  array.Add(&a, 0);
  array.Add(nullptr, 0);
  array.Add(nullptr);
  array.Insert(nullptr, 0);
  array.Insert(&b, -1);
  array.Insert(&b, 2);
  array.Remove(nullptr);
  array.Remove(&b);
  EXPECT_EQ(array.Find(nullptr), -1);
  EXPECT_EQ(array.Size(), 1);
  EXPECT_EQ(log.Lines(),
            (Lines{"ERROR: CNArray::Add -> !el -> return", "ERROR: CNArray::Add -> !pArray -> return",
                   "ERROR: CNArray::Insert -> !el -> return",
                   "ERROR: CNArray::Insert -> iIndex<0 || iIndex>=m_nArrayEl -> return",
                   "ERROR: CNArray::Insert -> iIndex<0 || iIndex>=m_nArrayEl -> return",
                   "ERROR: CNArray::Remove -> !el -> return", "ERROR: CNArray::Remove -> (i=Find(el))==-1 -> return",
                   "ERROR: CNArray::Find -> !el -> return -1"}));
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
      {"plain", ";", false, {"plain"}},
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
  int iMode = 0;
  strings[0]->iGetMode(&iMode);
  EXPECT_EQ(iMode, -1);
  EXPECT_EQ(strings.Find("last"), 3);
  EXPECT_EQ(strings.Find("Last"), -1);
  strings.Remove("first");
  EXPECT_EQ(Texts(strings), (Lines{"first", "", "last"}));
  more.Add(strings, 1);  // empty texts are left out
  more.Add(more, 1);
  EXPECT_EQ(Texts(more), (Lines{"first", "last", "first", "last"}));
  strings.RemoveAll();
  EXPECT_EQ(strings.Size(), 0);
  EXPECT_EQ(strings.Find("first"), -1);
}

TEST(TextArrays, RefusalsLog) {
  TestFolder folder;
  TestLog log(folder);
  CNCharArray chars;
  CNStringArray strings;
  chars.Add(nullptr, 1);
  EXPECT_EQ(chars[0], nullptr);
  EXPECT_EQ(chars.Set(nullptr, ";", false), -1);
  strings.Add(static_cast<const char*>(nullptr), 1);
  strings.Add(CNString("", 0), 1);
  EXPECT_EQ(strings.Find(nullptr), -1);
  strings.Remove(nullptr);
  strings.Remove("missing");
  EXPECT_EQ(strings.Set(nullptr, ';', false), -1);
  EXPECT_EQ(chars.Size() + strings.Size(), 0);
  EXPECT_EQ(
      log.Lines(),
      (Lines{"ERROR: CNCharArray::Add -> !string -> return",
             "ERROR: CNCharArray::operator[] -> n>=m_nArrayEl -> return NULL",
             "ERROR: CNCharArray::Set -> !string -> return -1", "ERROR: CNStringArray::Add -> !string -> return",
             "ERROR: CNStringArray::Add -> !string.Length() -> return",
             "ERROR: CNStringArray::Find -> !string -> return -1", "ERROR: CNStringArray::Remove -> !string -> return",
             "ERROR: CNStringArray::Remove -> (i=Find(string))==-1 -> return",
             "ERROR: CNStringArray::Set -> !string -> return -1"}));
}
