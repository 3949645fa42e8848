#include "launcher/Answers.h"

#include <cstring>
#include <initializer_list>

#include "foundation/Text.h"
#include "foundation/os/Os.h"

namespace {

const long MOST_BYTES = 4 << 20;

const struct {
  int iAnswer;
  const char* szWord;
} ANSWER_WORDS[] = {{ANSWER_OK, "ok"},       {ANSWER_CANCEL, "cancel"},      {ANSWER_ABORT, "abort"},
                    {ANSWER_RETRY, "retry"}, {ANSWER_IGNORE, "ignore"},      {ANSWER_YES, "yes"},
                    {ANSWER_NO, "no"},       {ANSWER_TRY_AGAIN, "tryagain"}, {ANSWER_CONTINUE, "continue"}};

const struct {
  const char* szWord;
  AnswerKind kind;
  bool bHasValue;
} VERBS[] = {{"set", AnswerKind::Set, true},
             {"tick", AnswerKind::Tick, true},
             {"press", AnswerKind::Press, false},
             {"message", AnswerKind::Message, true}};

// '*' stands for any characters, also none.
bool bMatches(const char* szText, const char* szPattern) {
  const char *pStar = nullptr, *pBehind = nullptr;
  while (*szText) {
    if (*szPattern == '*') {
      pStar = szPattern++;
      pBehind = szText;
    } else if (*szPattern == *szText) {
      szPattern++;
      szText++;
    } else if (pStar) {
      szPattern = pStar + 1;
      szText = ++pBehind;
    } else {
      return false;
    }
  }
  while (*szPattern == '*') szPattern++;
  return !*szPattern;
}

// The lines of one file, one after the other.
class Reader {
 public:
  explicit Reader(const char* szText) : m_pNext(szText) {}

  bool bNext() {
    if (!*m_pNext) return false;
    const size_t nLength = strcspn(m_pNext, "\n");
    CNString csUtf8;
    csUtf8.Copy(m_pNext, static_cast<long>(nLength));
    csUtf8.TrimRight();
    bWhole = bUtf8ToCp1250(csUtf8.Text(), csLine);
    m_pNext += nLength + (m_pNext[nLength] == '\n');
    iLine++;
    return true;
  }
  // A line that goes on with the value of the one before.
  bool bGoesOn() const { return *pBegin() == '|'; }
  const char* pBegin() const { return csLine.Text() + strspn(csLine.Text(), " \t"); }

  CNString csLine;
  int iLine = 0;
  bool bWhole = true;  // the line has no character that is not in the code page

 private:
  const char* m_pNext;
};

// The text behind "=" or "|": one blank there is not part of it.
const char* pValue(const char* p) { return p + 1 + (p[1] == ' '); }

void CutBlanks(CNString& csText) {
  while (!csText.bEmpty() && (csText.EndsWith(" ") || csText.EndsWith("\t"))) csText.SetLength(csText.Length() - 1);
}

int iAnswerOf(const CNString& csWord) {
  for (const auto& row : ANSWER_WORDS)
    if (iOsCompareNoCase(csWord.Text(), row.szWord) == 0) return row.iAnswer;
  return 0;
}

// Reads a line of a page; null when it is understood, else what is wrong.
const char* szReadLine(const char* p, AnswerLine& line) {
  CNString csVerb;
  csVerb.Copy(p, static_cast<long>(strcspn(p, " \t=")));
  for (const auto& verb : VERBS) {
    if (!csVerb.IsEqual(verb.szWord)) continue;
    p += csVerb.Length();
    p += strspn(p, " \t");
    const size_t nName = verb.bHasValue ? strcspn(p, "=") : strlen(p);
    if (verb.bHasValue && !p[nName]) return "\"=\" and a value are missing";
    line.kind = verb.kind;
    line.csName.Copy(p, static_cast<long>(nName));
    CutBlanks(line.csName);
    if (line.csName.bEmpty()) return "a name is missing";
    line.csValue = verb.bHasValue ? pValue(p + nName) : "";
    if (verb.kind == AnswerKind::Tick && !line.csValue.IsEqual("0") && !line.csValue.IsEqual("1"))
      return "the value is neither 0 nor 1";
    if (verb.kind != AnswerKind::Message) return nullptr;
    line.iAnswer = iAnswerOf(line.csName);
    line.csName = line.csValue;
    return line.iAnswer ? nullptr : "there is no such answer to a message";
  }
  return "it begins with none of: page, set, tick, press, message";
}

void AddValue(CNString& csOut, const char* szValue) {
  csOut.Concat(" = ");
  for (const char* p = szValue; *p; p++) {
    if (*p == '\r') continue;
    if (*p == '\n')
      csOut.Concat("\r\n  | ");
    else
      csOut.Concat(p, 1);
  }
}

}  // namespace

int AnswerPage::iLastPress() const {
  int iLast = -1;
  for (int i = 0; i < lines.Size(); i++)
    if (lines[i]->kind == AnswerKind::Press) iLast = i;
  return iLast;
}

const char* Answers::szWord(int iAnswer) {
  for (const auto& row : ANSWER_WORDS)
    if (row.iAnswer == iAnswer) return row.szWord;
  return "";
}

// ---- reading ----

bool Answers::bRead(const char* szUtf8, CNString& csFault) {
  Reader reader(szUtf8);
  AnswerPage* pPage = nullptr;
  AnswerLine* pLast = nullptr;  // whose value may go on
  const char* szFault = nullptr;
  for (; !szFault && reader.bNext();) {
    const char* p = reader.pBegin();
    if (!reader.bWhole) szFault = "it is not UTF-8, or has a character that setup's code page (1250) has not";
    if (!*p || *p == '#' || szFault) continue;
    if (reader.bGoesOn()) {
      const bool bMessage = pLast && pLast->kind == AnswerKind::Message;
      CNString* pText = bMessage ? &pLast->csName : pLast && pLast->kind == AnswerKind::Set ? &pLast->csValue : nullptr;
      if (!pText) szFault = "there is no value that it could go on with";
      if (!pText) continue;
      pText->Concat("\n");
      pText->Concat(pValue(p));
      continue;
    }
    pLast = nullptr;
    if (strncmp(p, "page ", 5) == 0) {
      CNString csName(p + 5 + strspn(p + 5, " \t"), 0);
      CutBlanks(csName);
      pPage = &Page(csName.Text());
      pPage->iLine = reader.iLine;
      continue;
    }
    AnswerLine* pLine = new AnswerLine{AnswerKind::Press, CNString(), CNString(), 0, reader.iLine};
    (pPage ? *pPage : Page("")).lines.Add(pLine, 1);
    szFault = szReadLine(p, *pLine);
    if (!szFault && !pPage && pLine->kind != AnswerKind::Message) szFault = "it stands before the first page";
    pLast = pLine;
  }
  if (szFault) csFault.Printf("Answers::bRead", "csFault", "%d: %s", reader.iLine, szFault);
  return !szFault;
}

bool Answers::bReadFile(const char* szPath, CNString& csFault) {
  OsFile file;
  CNString csText, csWhat;
  const int64_t size = file.bOpen(szPath, OsOpenMode::Read) ? file.Size() : -1;
  if (size > 0 && size <= MOST_BYTES) csText.SetLength(static_cast<long>(size));
  if (size < 0 || size > MOST_BYTES || (size && file.lRead(csText.Ptr(), static_cast<size_t>(size)) != size)) {
    csFault.Printf("Answers::bReadFile", "csFault", "%s: the file cannot be read", szPath);
    return false;
  }
  if (size && strlen(csText.Text()) != static_cast<size_t>(size)) {  // what is behind a zero would be passed over
    csFault.Printf("Answers::bReadFile", "csFault", "%s: the file is not UTF-8", szPath);
    return false;
  }
  const bool bMark = strncmp(csText.Text(), "\xEF\xBB\xBF", 3) == 0;
  if (bRead(csText.Text() + (bMark ? 3 : 0), csWhat)) return true;
  csFault.Printf("Answers::bReadFile", "csFault", "%s:%s", szPath, csWhat.Text());
  return false;
}

// ---- writing ----

void Answers::Write(const char* szTitle, CNString& csUtf8) const {
  CNString csText;
  csText.Printf("Answers::Write", "csText", "# Answers for an unattended run of %s, read by /ANSWERS=FILE.\r\n",
                szTitle);
  for (int i = 0; i < m_Pages.Size(); i++) {
    const AnswerPage& page = *m_Pages[i];
    if (!page.lines.Size()) continue;
    csText.Concat("\r\npage ");
    csText.Concat(page.csName.Text());
    csText.Concat("\r\n");
    for (int j = 0; j < page.lines.Size(); j++) {
      const AnswerLine& line = *page.lines[j];
      const bool bMessage = line.kind == AnswerKind::Message;
      csText.Concat("  ");
      csText.Concat(VERBS[static_cast<int>(line.kind)].szWord);
      csText.Concat(" ");
      csText.Concat(bMessage ? szWord(line.iAnswer) : line.csName.Text());
      if (line.kind != AnswerKind::Press) AddValue(csText, bMessage ? line.csName.Text() : line.csValue.Text());
      csText.Concat("\r\n");
    }
  }
  Cp1250ToUtf8(csText.Text(), csUtf8);
}

bool Answers::bWriteFile(const char* szPath, const char* szTitle) const {
  CNString csUtf8, csFolder, csNew;
  OsFile file;
  const char* pName = strrchr(szPath, '\\');
  csFolder.Copy(szPath, pName ? static_cast<long>(pName + 1 - szPath) : 0);
  Write(szTitle, csUtf8);
  if (!bOsMakeTempFile(csFolder.Text(), "ans", csNew)) return false;
  const bool bWritten = file.bOpen(csNew.Text(), OsOpenMode::Truncate) &&
                        file.bWrite(csUtf8.Text(), static_cast<size_t>(csUtf8.Length())) && file.bClose() &&
                        bOsRename(csNew.Text(), szPath);
  file.bClose();
  if (!bWritten) bOsDeleteFile(csNew.Text());
  return bWritten;
}

// ---- pages ----

const AnswerPage* Answers::pPage(const char* szName) const {
  for (int i = 0; i < m_Pages.Size(); i++)
    if (m_Pages[i]->csName.IsEqual(szName)) return m_Pages[i];
  return nullptr;
}

AnswerPage& Answers::Page(const char* szName) {
  for (int i = 0; i < m_Pages.Size(); i++)
    if (strcmp(m_Pages[i]->csName.Text(), szName) == 0) return *m_Pages[i];
  auto* pPage = new AnswerPage;
  pPage->csName = szName;
  m_Pages.Add(pPage, 1);
  return *pPage;
}

AnswerPage& Answers::StartPage(const char* szName) {
  AnswerPage& page = Page(szName);
  for (int i = page.lines.Size() - 1; i >= 0; i--)
    if (page.lines[i]->kind != AnswerKind::Message) page.lines.Remove(page.lines[i]);
  return page;
}

void Answers::Add(AnswerPage& page, AnswerKind kind, const char* szName, const char* szValue) {
  auto* pLine = new AnswerLine{kind, CNString(szName, 0), CNString(szValue, 0), 0, 0};
  page.lines.Add(pLine, 1);
}

int Answers::iMessage(const char* szPage, const char* szText, int* pLine) const {
  CNString csText(szText, 0);
  if (!csText.bEmpty()) csText.SubstituteAll("Answers::iMessage", "csText", "\r", "");
  for (const char* szName : {szPage, ""}) {
    const AnswerPage* pFound = pPage(szName);
    for (int i = 0; pFound && i < pFound->lines.Size(); i++) {
      const AnswerLine& line = *pFound->lines[i];
      if (line.kind != AnswerKind::Message || !bMatches(csText.Text(), line.csName.Text())) continue;
      *pLine = line.iLine;
      return line.iAnswer;
    }
  }
  return 0;
}

void Answers::KeepMessage(const char* szPage, const char* szText, int iAnswer) {
  AnswerPage& page = Page(szPage);
  AnswerLine* pKept = nullptr;
  for (int i = 0; i < page.lines.Size(); i++)
    if (page.lines[i]->kind == AnswerKind::Message && page.lines[i]->csName.IsEqual(szText)) pKept = page.lines[i];
  if (!pKept) page.lines.Add(pKept = new AnswerLine{AnswerKind::Message, CNString(szText, 0), CNString(), 0, 0}, 1);
  pKept->iAnswer = iAnswer;
}
