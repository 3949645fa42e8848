#include "controls/Variables.h"

#include <gtest/gtest.h>

#include <string>

TEST(Variables, KeepTheOrderAndChangeTheFirstRecord) {
  CNVariables variables;
  EXPECT_EQ(variables.pFind("a"), nullptr);
  variables.Set("a", "1");
  CNVariable* pFirst = variables.pFind("a");
  variables.AddTable();
  variables.Set("A", "2");
  variables.Set("a", "3");
  EXPECT_EQ(variables.Size(), 2);
  EXPECT_EQ(variables.pFind("a"), pFirst);
  EXPECT_STREQ(pFirst->csValue.Ptr(), "3");
  EXPECT_STREQ(variables[1]->csName.Ptr(), "A");
  EXPECT_EQ(variables[2], nullptr);
  variables.Set("a", "");
  EXPECT_STREQ(pFirst->csValue.Ptr(), "");
  variables.Set(nullptr, "x");
  variables.Set("b", nullptr);
  EXPECT_EQ(variables.Size(), 2);
  EXPECT_EQ(variables.pFind(nullptr), nullptr);
}

TEST(Variables, RecordsStayWhereTheyAreWhileTheStoreGrows) {
  CNVariables variables;
  variables.Set("v0", "0");
  const CNVariable* pFirst = variables.pFind("v0");
  for (int i = 0; i < 3000; i++) variables.Set(("v" + std::to_string(i)).c_str(), std::to_string(i).c_str());
  EXPECT_EQ(variables.Size(), 3000);
  EXPECT_EQ(variables.pFind("v0"), pFirst);
  for (int i = 0; i < 3000; i++)
    ASSERT_EQ(variables.pFind(("v" + std::to_string(i)).c_str())->csValue.Text(), std::to_string(i));
  EXPECT_EQ(variables.pFind("v3000"), nullptr);
}
