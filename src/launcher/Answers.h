// The answers that an unattended run gives in a person's place; docs/formats.md describes their file. Texts are code
// page 1250. A page is known by its name, one without a name by "#" and its number.
#pragma once

#include "controls/MessageSink.h"
#include "foundation/CNArray.h"

enum class AnswerKind { Set, Tick, Press, Message };

struct AnswerLine {
  AnswerKind kind;
  CNString csName;   // of the field, the variable of the item, the button; Message: the text, with '*' for any
  CNString csValue;  // Set; Tick: "1" or "0"
  int iAnswer = 0;   // Message: a MessageAnswer
  int iLine = 0;     // where it stands in the file, from 1
};

struct AnswerPage {
  CNString csName;  // "" for what holds on all pages
  CNArray<AnswerLine> lines;
  int iLine = 0;

  // The last press is the one that leaves the page; -1 without any.
  int iLastPress() const;
};

class Answers {
 public:
  // False when something cannot be understood; csFault then is "LINE: what is wrong".
  bool bRead(const char* szUtf8, CNString& csFault);
  // The same, with the file's path in front.
  bool bReadFile(const char* szPath, CNString& csFault);
  // Takes the old file's place in one step; what was there stays when that fails.
  bool bWriteFile(const char* szPath, const char* szTitle) const;
  void Write(const char* szTitle, CNString& csUtf8) const;

  int Size() const { return m_Pages.Size(); }
  const AnswerPage& operator[](int i) const { return *m_Pages[i]; }
  const AnswerPage* pPage(const char* szName) const;
  // The page's lines, all removed but those of message boxes; added when it is new.
  AnswerPage& StartPage(const char* szName);
  static void Add(AnswerPage& page, AnswerKind kind, const char* szName, const char* szValue);
  // The answer to a box shown on that page, 0 without one; pLine: where it stands.
  int iMessage(const char* szPage, const char* szText, int* pLine) const;
  // Keeps an answer; a later one to the same text replaces it.
  void KeepMessage(const char* szPage, const char* szText, int iAnswer);

  static const char* szWord(int iAnswer);  // "yes" ...; "" for a number that is none

 private:
  AnswerPage& Page(const char* szName);

  CNArray<AnswerPage> m_Pages;
};
