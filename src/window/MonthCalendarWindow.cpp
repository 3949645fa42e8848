// Calendars. Their text is the selected day, "2026-11-21", or with MULTISELECT the days "2026-11-21..2026-11-24".
#include <algorithm>
#include <cstring>

#include "window/SimpleWindows.h"

namespace {

const int MOST_DAYS = 366;
const wchar_t* const LAST_DAYS = L"OrbitLastDays";  // a property: the days that the wizard knows of

// The selected days, the first and the last.
struct Days {
  SYSTEMTIME ends[2] = {};

  explicit Days(HWND hWnd) : m_bSeveral(GetWindowLongW(hWnd, GWL_STYLE) & MCS_MULTISELECT) {
    SendMessageW(hWnd, m_bSeveral ? MCM_GETSELRANGE : MCM_GETCURSEL, 0, reinterpret_cast<LPARAM>(ends));
  }
  bool Select(HWND hWnd) const {
    return SendMessageW(hWnd, m_bSeveral ? MCM_SETSELRANGE : MCM_SETCURSEL, 0, reinterpret_cast<LPARAM>(ends)) != 0;
  }
  void Text(CNString& csText) const {
    csText = "";
    AppendDate(ends[0], csText);
    if (!m_bSeveral) return;
    csText.Concat("..");
    AppendDate(ends[1], csText);
  }
  HANDLE Key() const {
    const auto key = [](const SYSTEMTIME& day) { return (day.wYear * 13u + day.wMonth) * 32u + day.wDay; };
    return reinterpret_cast<HANDLE>(static_cast<UINT_PTR>(key(ends[0]) * 4099u + key(ends[1])));
  }

 private:
  bool m_bSeveral;
};

bool bSetText(HWND hWnd, const char* szText) {
  int first[3], last[3];
  if (iNumbersOf(szText, first, 3) < 3) return true;  // what is no date changes nothing
  const char* szLast = strstr(szText, "..");
  if (!szLast || iNumbersOf(szLast, last, 3) < 3) std::copy(first, first + 3, last);
  Days days(hWnd);
  TakeDate(first, days.ends[0]);
  TakeDate(last, days.ends[1]);
  const bool bDone = days.Select(hWnd);
  SetPropW(hWnd, LAST_DAYS, Days(hWnd).Key());
  return bDone;
}

bool bGetText(HWND hWnd, CNString& csText) {
  Days(hWnd).Text(csText);
  return true;
}

// The control also tells of changes, now and then, when there was none.
NativeEvent Notify(NativeControl& native, NMHDR& message) {
  if (message.code != MCN_SELCHANGE) return ChangeEvent(false);
  const HANDLE hKey = Days(native.hWnd()).Key();
  const bool bChanged = GetPropW(native.hWnd(), LAST_DAYS) != hKey;
  SetPropW(native.hWnd(), LAST_DAYS, hKey);
  return ChangeEvent(bChanged);
}

void SetColors(const NativeControl& native) {
  const BaseControl& control = native.Control();
  static const int GROUNDS[] = {MCSC_BACKGROUND, MCSC_MONTHBK};
  if (control.m_Background.bSet || control.m_TextColor.bSet) DropTheme(native.hWnd());
  for (const int iGround : GROUNDS)
    if (control.m_Background.bSet)
      SendMessageW(native.hWnd(), MCM_SETCOLOR, static_cast<WPARAM>(iGround),
                   static_cast<LPARAM>(ToColorRef(control.m_Background)));
  if (control.m_TextColor.bSet)
    SendMessageW(native.hWnd(), MCM_SETCOLOR, MCSC_TEXT, static_cast<LPARAM>(ToColorRef(control.m_TextColor)));
}

// A calendar without a size takes that of one month.
void Created(NativeControl& native) {
  const HWND hWnd = native.hWnd();
  SendMessageW(hWnd, MCM_SETMAXSELCOUNT, MOST_DAYS, 0);
  SetColors(native);
  RECT month = {}, present;
  GetClientRect(hWnd, &present);
  if (!present.right && SendMessageW(hWnd, MCM_GETMINREQRECT, 0, reinterpret_cast<LPARAM>(&month)))
    SetWindowPos(hWnd, nullptr, 0, 0, month.right, month.bottom, SWP_NOMOVE | SWP_NOZORDER | SWP_NOACTIVATE);
  SetPropW(hWnd, LAST_DAYS, Days(hWnd).Key());
  ShowSource(native);
}

}  // namespace

const NativeKind g_MonthCalendarWindow = {.kind = ControlKind::MonthCalendar,
                                          .bField = true,
                                          .pPrepare = PrepareWithoutCaption,
                                          .pCreated = Created,
                                          .pSetText = bSetText,
                                          .pGetText = bGetText,
                                          .pNotify = Notify};
