#include "launcher/Answers.h"

#include <string>

#include "support/TestFolder.h"

static std::string Fault(const std::string& text) {
  Answers answers;
  CNString csFault;
  return answers.bRead(text.c_str(), csFault) ? "" : csFault.Text();
}

TEST(Answers, ComeBackAsTheyWereWritten) {
  Answers answers;
  answers.KeepMessage("folder", "Make\n'C:\\x'?", ANSWER_NO);
  answers.KeepMessage("folder", "Make\n'C:\\x'?", ANSWER_YES);
  AnswerPage& page = answers.StartPage("folder");
  Answers::Add(page, AnswerKind::Set, "default_path", " C:\\Apps\\Plumo \xE8 | = # ");
  Answers::Add(page, AnswerKind::Set, "address", "Ulica 8\r\n\n| Zagreb");
  Answers::Add(page, AnswerKind::Set, "company", "");
  Answers::Add(page, AnswerKind::Tick, "with_help", "1");
  Answers::Add(page, AnswerKind::Press, "b_next", "");
  const TestFolder folder;
  const std::string path = folder.Path("answers.txt");
  folder.Write("answers.txt.new", "somebody's");
  ASSERT_TRUE(answers.bWriteFile(path.c_str(), "Plumo"));
  const std::string text = TestFolder::ReadFile(path);
  EXPECT_NE(text.find("\r\n  set default_path =  C:\\Apps\\Plumo \xC4\x8D | = # \r\n"), std::string::npos) << text;
  EXPECT_EQ(folder.Read("answers.txt.new"), "somebody's");

  Answers again;
  CNString csFault, csText;
  ASSERT_TRUE(again.bReadFile(path.c_str(), csFault)) << csFault.Text();
  again.Write("Plumo", csText);
  EXPECT_EQ(csText.Text(), text);
  int iLine = 0;
  EXPECT_EQ(again.iMessage("folder", "Make\r\n'C:\\x'?", &iLine), ANSWER_YES);
  EXPECT_EQ(again.iMessage("other", "Make\n'C:\\x'?", &iLine), 0);
  EXPECT_STREQ(again.pPage("folder")->lines[2]->csValue.Text(), "Ulica 8\n\n| Zagreb");
  folder.Write("marked.txt", "\xEF\xBB\xBFpage  folder \t\r\npress b_next \r\n");
  Answers marked;
  ASSERT_TRUE(marked.bReadFile(folder.Path("marked.txt").c_str(), csFault)) << csFault.Text();
  ASSERT_NE(marked.pPage("folder"), nullptr);
  EXPECT_STREQ(marked.pPage("folder")->lines[0]->csName.Text(), "b_next");
  // A page that is left once more keeps what its messages were told, and nothing else.
  EXPECT_EQ(again.StartPage("folder").lines.Size(), 1);
}

TEST(Answers, MessagesAreFoundByTheirText) {
  Answers answers;
  CNString csFault;
  ASSERT_TRUE(
      answers.bRead("\nmessage No = *\n# x\npage a\n  message yes = *does not exist*?\n message ok = a*b*c\n"
                    "page b\nmessage cancel =\n | x\n",
                    csFault));
  const struct {
    const char *szPage, *szText;
    int iAnswer, iLine;
  } rows[] = {{"a", "C:\\x\ndoes not exist. Make it?", ANSWER_YES, 5},
              {"a", "aXXbbYYcc", ANSWER_OK, 6},
              {"a", "aXXbbYYcd", ANSWER_NO, 2},
              {"b", "\nx", ANSWER_CANCEL, 8},
              {"b", "", ANSWER_NO, 2},
              {"none", "does not exist?", ANSWER_NO, 2}};
  for (const auto& row : rows) {
    int iLine = 0;
    EXPECT_EQ(answers.iMessage(row.szPage, row.szText, &iLine), row.iAnswer) << row.szText;
    EXPECT_EQ(iLine, row.iLine) << row.szText;
  }
}

TEST(Answers, WhatCannotBeUnderstoodIsNamedWithItsLine) {
  const struct {
    const char *szText, *szFault;
  } rows[] = {
      {"page a\nset x = 1\n|more\npress b", ""},
      {"page a\npush b", "2: it begins with none of: page, set, tick, press, message"},
      {"page a\nset x", "2: \"=\" and a value are missing"},
      {"page a\nset = 1", "2: a name is missing"},
      {"page a\npress", "2: a name is missing"},
      {"\ntick x = 2", "2: the value is neither 0 nor 1"},
      {"set x = 2", "1: it stands before the first page"},
      {"page a\n\nmessage maybe = x", "3: there is no such answer to a message"},
      {"page a\n| more", "2: there is no value that it could go on with"},
      {"page a\npress b\n| more", "3: there is no value that it could go on with"},
      {"page a\n# \xE4\xB8\xAD\nset x = 1",
       "2: it is not UTF-8, or has a character that setup's code page (1250) has not"},
      {"page a\nset x = \xE8", "2: it is not UTF-8, or has a character that setup's code page (1250) has not"},
  };
  for (const auto& row : rows) EXPECT_EQ(Fault(row.szText), row.szFault) << row.szText;
  Answers answers;
  CNString csFault;
  EXPECT_FALSE(answers.bReadFile("C:\\no such file.txt", csFault));
  EXPECT_STREQ(csFault.Text(), "C:\\no such file.txt: the file cannot be read");
  const TestFolder folder;
  folder.Write("zero.txt", std::string("# a\n\0page x\n", 12));
  EXPECT_FALSE(answers.bReadFile(folder.Path("zero.txt").c_str(), csFault)) << "half of it is not enough";
}
