// The kinds that hold other controls: frames, group boxes, tab controls and property sheets with their pages. What they
// hold are ordinary entries of DialogInfo::m_Controls, in the order of the lines, up to the entry of the line that
// closes the block; each names the container it stands in (BaseControl::m_pParent), and its coordinates count from that
// container's inside: a frame's and a page's upper left corner, for a group box the corner under its title.
#pragma once

#include "controls/SimpleKinds.h"

extern const SimpleKind g_CNFrame, g_CNGroupBox, g_CNTabControl, g_CNPropertySheet, g_CNTab, g_CNSheet, g_CNSplitter;

class CNContainer : public CNSimpleControl {
 public:
  // Both must outlive the control. szEndWord closes the block.
  CNContainer(const SimpleKind& kind, const char* szEndWord) : CNSimpleControl(kind), m_szEndWord(szEndWord) {}
  // A container may do without anything behind its keyword.
  int iReadScript(ScriptCursor& cursor, ScriptContext& context) override;
  const char* szEndWord() const { return m_szEndWord; }

 protected:
  // A page is as large as its tab control leaves it.
  bool bWritesSize() const override { return Kind() != ControlKind::Tab; }

 private:
  const char* const m_szEndWord;
};

// TAB_CONTROL with its TABs, PROPERTY_SHEET (drawn in the same way) with its SHEETs. Controls between the pages stand
// on none: they belong to what the tab control stands in.
class CNTabControl : public CNContainer {
 public:
  using CNContainer::CNContainer;
  // The pages' captions.
  bool bItemTexts(CNCharArray& texts) const override;
  // The page that the line begins, to be read and added; null for any other line.
  CNContainer* pMakePage(const char* pLine, const char* pEnd) const;

  CNArray<CNContainer> m_Pages;  // not owned
};

bool bIsTabControl(const BaseControl* pControl);

// The line that closes a container.
class CNBlockEnd : public BaseControl {
 public:
  explicit CNBlockEnd(const CNContainer& container)
      : BaseControl(ControlKind::BlockEnd), m_szWord(container.szEndWord()) {}
  const char* szKeyword() const override { return m_szWord; }
  const char* szClassName() const override { return "CNBlockEnd"; }
  void WriteControl(CNString& csOut) const override { csOut.Concat(m_szWord); }

 private:
  const char* const m_szWord;
};
