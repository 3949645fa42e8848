// Reports faults of a script's text: the prescribed message box, with the file and the line.
#pragma once

#include "controls/MessageSink.h"
#include "foundation/CNString.h"

enum ScriptFault : int {
  FAULT_APOSTROPHE = 0,
  FAULT_QUOTE = 1,
  FAULT_COLON = 2,
  FAULT_PARENTHESIS = 3,
  FAULT_ID = 4,
  FAULT_COMMA = 5,
  FAULT_MISSING_WORD = 6,  // with the missing word; 7 means the same
  FAULT_MISSING_WORD_ALSO = 7,
  FAULT_END_OF_SCRIPT = 8,
};

class ScriptReport {
 public:
  // The sink must outlive the report; null shows nothing.
  explicit ScriptReport(MessageSink* pSink) : m_pSink(pSink) {}

  // Keeps the start of the script's text (not a copy: it must outlive the reading) and a copy of the file's name.
  // Either may be null; a missing text is logged.
  void Setup(const char* szBuffer, const char* szFileName);
  // Shows the fault found at pPosition (inside the text given to Setup, or null when unknown). szWord fills the text of
  // the missing-word codes. Always returns 0: a syntax fault never stops the reading. The same fault at the same
  // position is shown once.
  int iReport(int iFault, const char* pPosition, const char* szWord = nullptr);
  // A message of its own wording about the script (caption "Syntax Error" and the like), without an owner window.
  void Show(const char* szText, const char* szCaption, MessageIcon icon = MessageIcon::None);
  int FaultCount() const { return m_iFaults; }

 private:
  int iLine(const char* pPosition);

  MessageSink* m_pSink;
  const char* m_szScript = nullptr;
  size_t m_nScriptSize = 0;
  size_t m_nCounted = 0;  // how far lines were counted, and the line there: many faults must not count from the start
  int m_iCountedLine = 1;
  const char* m_pLastPosition = nullptr;
  int m_iLastFault = -1;
  CNString m_csFileName;
  int m_iFaults = 0;
};
