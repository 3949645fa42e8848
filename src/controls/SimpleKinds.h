// The kinds of one line that the system draws without help: rich edits, sliders, dates, bars and the like. They share
// one class; what a kind has of its own stands in its SimpleKind, in a unit of its own (CNTrackBar.cpp, CNHotKey.cpp
// ...).
#pragma once

#include "controls/BaseControl.h"

// What all controls of one kind have in common.
struct SimpleKind {
  ControlKind kind;
  const char* szKeyword;
  const char* szClassName;
  const char* szWindowClass;    // null: no window of its own
  uint32_t dwStyle = 0;         // added to the style that every control begins with
  uint32_t dwRemovedStyle = 0;  // taken away from it
  uint32_t dwExStyle = 0;
  const FlagRow* pFlags = nullptr;  // the kind's own flags
  int nFlags = 0;
};

class CNSimpleControl : public BaseControl {
 public:
  // kind must outlive the control.
  explicit CNSimpleControl(const SimpleKind& kind);
  const char* szWindowClass() const override { return m_Row.szWindowClass; }
  const char* szKeyword() const override { return m_Row.szKeyword; }
  const char* szClassName() const override { return m_Row.szClassName; }

  // What the line names beside its size: a file, a range, a first value. It is a bare word (several, or a group in
  // parentheses) or else the caption; "" without either.
  const char* szSource() const { return m_csOwnWords.bEmpty() ? m_csCaption.Text() : m_csOwnWords.Text(); }
  // True when the word stands among the flags or the bare words before the size.
  bool bHasWord(const char* szWord) const;

  CNString m_csOwnWords;  // the words before the size, as written

 protected:
  void ReadOwnWords(ScriptCursor& cursor, ScriptContext& context) override;
  void WriteOwnWords(CNString& csOut) const override;
  void ReadOwnFlags(ScriptContext& context) override;

 private:
  const SimpleKind& m_Row;
};

extern const SimpleKind g_CNRtf, g_CNTrackBar, g_CNUpDown, g_CNDateTime, g_CNMonthCalendar, g_CNIPAddress, g_CNHotKey,
    g_CNPager, g_CNAnimation, g_CNCursor, g_CNWave;

// The field of formatted text. Its caption is its text, or names an .rtf file whose contents it shows.
class CNRtf : public CNSimpleControl {
 public:
  CNRtf() : CNSimpleControl(g_CNRtf) {}
  // True when the caption names a file.
  bool bIsFile() const;

 protected:
  void ReadOwnFlags(ScriptContext& context) override;
};

// Reads up to nNumbers whole numbers out of a text, whatever stands between them: "0 100", "(0,100,5)", "1.2.3.4",
// "2026-11-21". A minus sign counts when no digit stands before it. Returns how many there were; the others stay as
// they were.
int iNumbersOf(const char* szText, int* pNumbers, int nNumbers);
