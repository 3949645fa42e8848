#include "controls/LayoutTable.h"

#include <algorithm>
#include <cstring>

#include "controls/ScriptText.h"

using namespace ScriptText;

namespace {

const int MOST_COLUMNS = 1000;  // of one span

// The number behind szWord in the range, or iDefault.
int iNumberBehind(const char* p, const char* pEnd, const char* szWord, int iDefault) {
  p = FindText(p, pEnd, szWord);
  if (!p) return iDefault;
  p = SkipBlanks(p + std::strlen(szWord), pEnd);
  return p < pEnd && bIsDigit(*p) ? iReadNumber(p, pEnd) : iDefault;
}

// What stands in a track's parentheses; szWord is "width=" or "height=". Without a number the track is a star.
void ReadTrack(const char* p, const char* pEnd, const char* szWord, LayoutTrack& track) {
  track.bHidden = iNumberBehind(p, pEnd, "hide=", 0) != 0;
  p = FindText(p, pEnd, szWord);
  if (!p) return;
  p += std::strlen(szWord);
  if (FindChar(p, std::min(p + 2, pEnd), '*')) return;
  p = SkipBlanks(p, pEnd);
  if (p == pEnd || !bIsDigit(*p)) return;
  track.bStar = false;
  track.iSize = iReadNumber(p, pEnd);
  if (p < pEnd && IsLetter(static_cast<unsigned char>(*p))) track.cUnit = *p;
}

void WriteTrack(CNString& csOut, const char* szStart, const LayoutTrack& track) {
  CNString csSize;
  csSize = "*";
  if (!track.bStar) csSize.Printf("CNLayoutTable::WriteControl", "csSize", "%d%c", track.iSize, track.cUnit);
  csOut.Concat(szStart);
  csOut.Concat(csSize.Text());
  csOut.Concat(track.bHidden ? " hide=1)\n" : ")\n");
}

const char COLUMN[] = "TABLE_COLUMN", ROW[] = "TABLE_ROW";

}  // namespace

void CNLayoutTable::AddCell(const char* szName, int iSpan) {
  const int iRow = m_Rows.Size() - 1;
  // The empty cells only move the next one on; what stands beyond the last column has no cell.
  if (iRow >= 0 && *szName && m_iNextColumn < m_Columns.Size()) {
    auto* pCell = new LayoutCell;
    pCell->csName = szName;
    pCell->iRow = iRow;
    pCell->iColumn = m_iNextColumn;
    pCell->iSpan = std::clamp(iSpan, 1, m_Columns.Size() - m_iNextColumn);
    m_Cells.Add(pCell, 1);
  }
  m_iNextColumn += std::clamp(iSpan, 1, MOST_COLUMNS);
}

void CNLayoutTable::AddCell(BaseControl& control) {
  const char* szFlags = control.m_csFlags.Text();
  AddCell(control.m_csName.Text(), iNumberBehind(szFlags, szFlags + control.m_csFlags.Length(), "SPAN(", 1));
}

// Returns the place behind the cell and its span; null when an apostrophe is missing.
const char* CNLayoutTable::pReadCell(const char* p, const char* pEnd) {
  const char* pClose = FindChar(p + 1, pEnd, '\'');
  if (!pClose) return nullptr;
  CNString csName;
  csName.Copy(p + 1, long(pClose - p - 1));
  p = SkipBlanks(pClose + 1, pEnd);
  const char* pSpanEnd = bStartsWith(p, pEnd, "SPAN(") ? FindChar(p, pEnd, ')') : nullptr;
  AddCell(csName.Text(), pSpanEnd ? iNumberBehind(p, pSpanEnd, "SPAN(", 1) : 1);
  return pSpanEnd ? pSpanEnd + 1 : p;
}

bool CNLayoutTable::bReadLine(const char* p, const char* pEnd) {
  while (p < pEnd && !m_bClosed) {
    const bool bRow = bStartsWith(p, pEnd, ROW);
    if (bRow || bStartsWith(p, pEnd, COLUMN)) {
      const char* pClose = FindChar(p, pEnd, ')');
      if (!pClose) pClose = pEnd;
      auto* pTrack = new LayoutTrack;
      ReadTrack(p, pClose, bRow ? "height=" : "width=", *pTrack);
      (bRow ? m_Rows : m_Columns).Add(pTrack, 1);
      m_iNextColumn = 0;
      p = pClose;
    } else if (*p == '\'') {
      p = pReadCell(p, pEnd);
      if (!p) return false;
      continue;
    } else if (*p == '-') {
      AddCell("", 1);
    } else if (*p == '}') {
      m_bClosed = true;
    } else if (!std::strchr("{, \t\r", *p)) {
      return false;
    }
    if (p < pEnd) p++;
  }
  return true;
}

void CNLayoutTable::WriteControl(CNString& csOut) const {
  csOut.Concat("TABLE_START\n{\n");
  for (int i = 0; i < m_Columns.Size(); i++) WriteTrack(csOut, "TABLE_COLUMN (width=", *m_Columns[i]);
  CNString csSpan;
  int iCell = 0;
  for (int iRow = 0; iRow < m_Rows.Size(); iRow++) {
    WriteTrack(csOut, "TABLE_ROW (height=", *m_Rows[iRow]);
    for (int iColumn = 0; iCell < m_Cells.Size() && m_Cells[iCell]->iRow == iRow; iCell++) {
      const LayoutCell& cell = *m_Cells[iCell];
      for (; iColumn < cell.iColumn; iColumn++) csOut.Concat("-\n");
      csOut.Concat("'");
      csOut.Concat(cell.csName.Text());
      csOut.Concat("'");
      if (cell.iSpan > 1) csOut.Concat(csSpan.Printf("CNLayoutTable::WriteControl", "csSpan", " SPAN(%d)", cell.iSpan));
      csOut.Concat("\n");
      iColumn += cell.iSpan;
    }
  }
  csOut.Concat("}");
}
