// Kinds that hold several items: combo boxes, list views, trees, menus, toolbars, headers. Their items stand on the
// lines behind the control's own, one a line, all in the grammar of a control's line:
//
//   KEYWORD 'name' "text" "text" TOOLTIP 'tip' 120, RGB(200,0,0), open.bmp, CHECKED ACTION: (command)
//
// A line that begins with a quote is an ITEM. Which keywords a kind has stands in its table.
#pragma once

#include "controls/BaseControl.h"

// A keyword of item lines and what it does to the level of the lines behind it. The first row that a line begins with
// counts. A row that closes a block stands at the level of the row that opened it.
enum class ItemLevel { Same, Opens, Closes };
struct ItemWord {
  const char* szWord;
  ItemLevel level = ItemLevel::Same;
};

// How an item looks beside its flags. In a line it stands among the flags: RGB(r,g,b), a file name ending in .bmp (or
// a bitmap IDB_...), LEFT or RIGHT. A text that shares its line with others carries it in front of itself, in angle
// brackets: "<RGB(200,0,0),open.bmp,RIGHT>text".
struct ItemLook {
  ControlColor text;
  CNString csPicture;  // null: none; "empty.bmp": none, but the room for it
  bool bRight = false;

  // Takes what [p, pEnd) says; what it does not say stays.
  void Read(const char* p, const char* pEnd);
};
// The text behind the bracket in front of szText, and what the bracket says in look; szText itself without a bracket.
const char* szBehindLook(const char* szText, ItemLook& look);

class CNItem : public BaseControl {
 public:
  explicit CNItem(const ItemWord& word) : BaseControl(ControlKind::Item), m_Word(word) {}
  const char* szKeyword() const override { return m_Word.szWord; }
  const char* szClassName() const override { return "CNItem"; }
  int iReadScript(ScriptCursor& cursor, ScriptContext& context) override;
  bool bIs(const char* szWord) const;
  ItemLevel Level() const { return m_Word.level; }
  // The text with that number as written, "" beyond the last.
  const char* szText(int i = 0) const { return i < m_Texts.Size() ? m_Texts[i] : ""; }
  // The argument of the flag WORD(argument); empty without it.
  void FlagArgument(const char* szWord, CNString& csArgument) const;
  // The text as it is shown, without its look, and that look with what the item's own says.
  const char* szShown(int i, ItemLook& look) const;
  // The name in the marker <%name%> that is all that the text with that number says behind its look; else empty.
  void MarkedVariable(int i, CNString& csName) const;
  // Gives both the written and the shown text with that number another one, behind the look that it has. A text that
  // is one marker stays written so.
  void SetText(int i, const char* szText);

  CNCharArray m_Texts;  // escapes turned into characters, variable markers still in them
  int m_iLevel = 0;     // 0 outside all blocks
  ItemLook m_Look;
  int m_iFirstText = 0;  // where its texts begin among those of its control
  // While its dialog is shown: its texts and its tooltip with the markers filled in.
  CNCharArray m_Shown;
  CNString m_csShownToolTip;

 protected:
  void ReadText(ScriptCursor& cursor, ScriptContext& context) override;
  void WriteText(CNString& csOut) const override;
  void ReadOwnFlags(ScriptContext& context) override;
  bool bWritesSize() const override;

 private:
  const ItemWord& m_Word;
};

class CNItemControl : public BaseControl {
 public:
  // Both tables and words must outlive the control. szEndWord ends the lines.
  template <size_t N>
  CNItemControl(ControlKind kind, const ItemWord (&words)[N], const char* szEndWord)
      : BaseControl(kind), m_pWords(words), m_nWords(N), m_szEndWord(szEndWord) {}
  // A missing end word is reported, and the control has no items.
  int iReadScript(ScriptCursor& cursor, ScriptContext& context) override;
  void WriteControl(CNString& csOut) const override;
  bool bItemTexts(CNCharArray& texts) const override;
  // Hands the texts, in the order of bItemTexts with their markers filled in, to the items' m_Shown.
  void TakeShown(const CNCharArray& texts) const;
  // Counts the texts of the items anew, after items or texts have come or gone.
  void CountTexts();
  void TakeIDs(int& iNewIDNum) override;
  const CNItemControl* pItemControl() const override { return this; }
  const char* szEndWord() const { return m_szEndWord; }
  // The item with the identifier; null for an unknown one.
  CNItem* pFindItem(int iID) const;

  CNArray<CNItem> m_Items;  // owned; every line, those that close a block as well

 protected:
  // Gives the items what only the whole list can say, once after reading. The cursor is in the line of the end word.
  virtual void ItemsRead(const ScriptCursor&, ScriptContext&) {}

 private:
  const ItemWord* pFindWord(const char* p, const char* pEnd) const;
  void ReadItem(ScriptCursor& cursor, ScriptContext& context, int& iLevel);

  const ItemWord* m_pWords;
  size_t m_nWords;
  const char* m_szEndWord;
};

// What choosing an item, or pressing an accelerator's key, runs: its name with the action behind it, or without a name
// (one that begins with a digit is a place in a tree) what stands between the action's parentheses. Empty when it does
// nothing.
void ItemCommand(const BaseControl& item, CNString& csCommand);

// Appends every quoted text of the line up to its first number, TOOLTIP or ACTION; a missing quote is reported.
void ReadQuotedTexts(ScriptCursor& cursor, ScriptContext& context, CNCharArray& texts);
// Appends the texts in quotes, each with a blank before it.
void WriteQuotedTexts(CNString& csOut, const CNCharArray& texts);
