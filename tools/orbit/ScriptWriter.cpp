#include "ScriptWriter.h"

#include <algorithm>
#include <cstring>
#include <vector>

#include "foundation/os/Os.h"

namespace {

// ---- variables ----

std::string Escaped(const char* szValue) {
  static const char ESCAPES[] = "\nn\rr\tt\"\"\\\\";
  std::string text;
  for (const char* p = szValue; *p; p++) {
    const char* pEscape = ESCAPES;
    while (*pEscape && *pEscape != *p) pEscape += 2;
    // The quote that ends the value must not follow a backslash; a backslash takes any other character with it too.
    const bool bLastBackslash = *p == '\\' && !p[1];
    text += *pEscape ? std::string{'\\', bLastBackslash ? ' ' : pEscape[1]} : std::string(1, *p);
  }
  return text;
}

// The engine's own variable belongs to no script, unless the script changed it.
bool IsEnginesOwn(const CNVariable& variable) {
  CNString csSystem;
  OsGetSystemName(csSystem);
  return !std::strcmp(variable.csName.Text(), "win_ver") && !std::strcmp(variable.csValue.Text(), csSystem.Text());
}

std::string Variables(COrbitWizard& wizard) {
  std::string lines;
  const CNVariables& variables = wizard.Variables();
  for (int i = 0; i < variables.Size(); i++)
    if (!IsEnginesOwn(*variables[i])) lines += "  " + VariableLine(*variables[i]) + "\n";
  return lines.empty() ? "" : "INIT\n" + lines + "END_INIT\n\n";
}

// ---- one dialog ----

std::string Quoted(char quote, const CNString& csText) {
  return csText.Ptr() ? std::string(" ") + quote + csText.Text() + quote : "";
}

// Something that is no number stands before the size: else it would be taken for the dialog's own number.
std::string Header(const DialogInfo& dialog, const std::string& number) {
  std::string words = dialog.m_bKindWord ? std::string(" ") + dialog.m_csKind.Text() : "";
  words += Quoted('\'', dialog.m_csName) + Quoted('"', dialog.m_csCaption);
  std::string line = "DIALOG" + number + (words.empty() ? " \"\"" : words);
  for (int i = 0; i < 4; i++)
    line += " " + std::to_string(dialog.m_iSize[i] - (i == 3 ? dialog.m_iHeightDifference : 0));
  if (!dialog.m_csFlags.bEmpty()) line += std::string(",") + dialog.m_csFlags.Text();
  return line + "\n";
}

// The line behind the header is the font, whatever it says: a tooltip time needs one before it.
std::string FontAndToolTipTime(const DialogInfo& dialog) {
  const DialogFont& font = dialog.m_Font;
  const bool bToolTipTime = dialog.m_iToolTipTime != -1;
  std::string lines;
  if (std::strchr(font.csFace.Text(), '"'))
    lines = std::string(font.csFace.Text()) + "\n";  // a bare face may hold what a quoted one cannot
  else if (font.csFace.Ptr() || bToolTipTime)
    lines = std::string("\"") + font.csFace.Text() + "\" " + std::to_string(font.iHeight) + " " +
            std::to_string(font.iWeight) + "\n";
  if (bToolTipTime) lines += "TOOLTIP_TIME '" + std::to_string(dialog.m_iToolTipTime) + "'\n";
  return lines;
}

// The lines that say something. Where comments stood are empty ones.
std::vector<std::string> TextLines(const CNString& csText) {
  std::vector<std::string> lines;
  for (const char* p = csText.Text(); *p;) {
    const size_t length = std::strcspn(p, "\n");
    if (std::strspn(p, " ") < length) lines.emplace_back(p, length);
    p += length + (p[length] == '\n');
  }
  return lines;
}

// Statements as their author indented them, moved as a whole; the last line, a word that ends them, goes to lastIndent.
std::string Statements(const CNString& csText, size_t indent, size_t lastIndent) {
  const std::vector<std::string> lines = TextLines(csText);
  size_t least = std::string::npos;
  for (size_t i = 0; i + 1 < lines.size(); i++) least = std::min(least, lines[i].find_first_not_of(' '));
  std::string text;
  for (size_t i = 0; i < lines.size(); i++) {
    const bool bLast = i + 1 == lines.size();
    text += (i ? "\n" : "") + std::string(bLast ? lastIndent : indent, ' ') +
            lines[i].substr(bLast ? lines[i].find_first_not_of(' ') : least);
  }
  return text;
}

std::string Action(const char* szKeyword, const CNString& csText) {
  if (csText.bEmpty()) return "";
  return std::string("  ") + szKeyword + "\n  START_ACTION\n" + Statements(csText, 4, 2) + "\n";
}

// ---- its controls ----

bool SamePartners(const BaseControl& a, const BaseControl& b) {
  if (a.m_Partners.Size() != b.m_Partners.Size()) return false;
  for (int i = 0; i < a.m_Partners.Size(); i++)
    if (a.m_Partners[i] != b.m_Partners[i]) return false;
  return true;
}

// Boxes of one name are no partners, so they are known by the partners that they share.
bool OfOneGroup(const BaseControl& a, const BaseControl& b) {
  for (int i = 0; i < a.m_Partners.Size(); i++)
    if (a.m_Partners[i] == &b) return true;
  return !std::strcmp(a.m_csName.Text(), b.m_csName.Text()) && SamePartners(a, b);
}

// Items and the lines of a box or table stand deeper than what is around them. A word END, which only a quote that was
// not closed can have brought into a line, would end the dialog's controls and becomes END_.
std::string Indented(const BaseControl& control) {
  std::string text = "  " + ControlText(control) + "\n";
  while (const char* pEnd = DialogInfo::pFindEnd(text.data(), text.data() + text.size()))
    text.insert(static_cast<size_t>(pEnd - text.data()) + 3, "_");
  const bool bLines = control.Kind() == ControlKind::MsgBox || control.Kind() == ControlKind::Table;
  if (!bLines && !control.pItemControl()) return text;
  for (size_t at = 0; (at = text.find('\n', at) + 1) < text.size();) {
    const bool bOuter = text[at] == '{' || text.find('\n', at) + 1 == text.size();
    text.insert(at, bOuter ? "  " : "    ");
  }
  return text;
}

// Groups of check boxes are not kept as such. One begins at a box that is no partner of the box before, and ends before
// the next control that is marked as the first behind a group. An END_GROUP without a group marks as well.
std::string Controls(const DialogInfo& dialog) {
  std::string lines;
  const BaseControl* pBox = nullptr;  // the last box of the group that is open
  bool bAny = false;
  for (int i = 0; i < dialog.m_Controls.Size(); i++) {
    const BaseControl& control = *dialog.m_Controls[i];
    const bool bBox = control.Kind() == ControlKind::CheckBox, bMarked = control.m_dwStyle & STYLE_GROUP;
    const bool bSame = bBox && control.m_bGrouped && pBox && OfOneGroup(*pBox, control);
    const bool bBegins = bBox && control.m_bGrouped && !bSame;
    const bool bEnds = pBox ? !bSame && (bBox || bMarked) : bMarked && !bBegins;
    lines += std::string(bEnds ? "  END_GROUP\n" : "") + (bBegins ? "  GROUP\n" : "") + Indented(control);
    if (bSame || bBegins || bEnds) pBox = bSame || bBegins ? &control : nullptr;
    bAny |= bBegins;
  }
  if (pBox) lines += "  END_GROUP\n";
  return lines + (dialog.m_bHasCheckGroups && !bAny ? "  GROUP\n" : "");
}

// The flow text ends with the word that ends the block. A dialog without any has that word on the line of END.
std::string EndOf(const DialogInfo& dialog) {
  return dialog.m_csFlow.bEmpty() ? "END END_DIALOG" : "END\n" + Statements(dialog.m_csFlow, 0, 0);
}

std::string Dialog(const DialogInfo& dialog, const std::string& number) {
  std::string text = Header(dialog, number) + FontAndToolTipTime(dialog) + "BEGIN\n";
  text += Action("START_BEFORE_DRAWING", dialog.m_csBeforeDrawing) + Controls(dialog);
  text += Action("START_AFTER_DRAWING", dialog.m_csAfterDrawing) + EndOf(dialog);
  // Where END was missing, the word may be part of a control line, and ends the block all the same.
  return text.substr(0, text.find("END_DIALOG")) + "END_DIALOG" + number + "\n";
}

}  // namespace

std::string VariableLine(const CNVariable& variable) {
  return std::string(variable.csName.Text()) + " = \"" + Escaped(variable.csValue.Text()) + "\"";
}

std::string ControlText(const BaseControl& control) {
  CNString csOut;
  control.WriteControl(csOut);
  return csOut.Text();
}

std::string ScriptOf(COrbitWizard& wizard) {
  std::string script = Variables(wizard);
  for (int i = 1; i <= wizard.DialogCount(); i++)
    script += (i > 1 ? "\n" : "") + Dialog(*wizard.GetDialog(i), std::to_string(i));
  return script;
}
