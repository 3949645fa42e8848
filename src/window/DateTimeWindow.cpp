// Fields for a date, "2026-11-21", or with TIME for a time, "14:05:00".
#include "window/SimpleWindows.h"

namespace {

bool bIsTime(HWND hWnd) { return (GetWindowLongW(hWnd, GWL_STYLE) & DTS_TIMEFORMAT) == DTS_TIMEFORMAT; }

bool bSetText(HWND hWnd, const char* szText) {
  int numbers[3] = {};
  SYSTEMTIME time;
  GetLocalTime(&time);
  const int nNumbers = iNumbersOf(szText, numbers, 3);
  if (bIsTime(hWnd)) {
    time.wHour = static_cast<WORD>(numbers[0]);
    time.wMinute = static_cast<WORD>(numbers[1]);
    time.wSecond = static_cast<WORD>(numbers[2]);
  } else {
    TakeDate(numbers, time);
  }
  // What is no date or time changes nothing.
  return nNumbers < 2 || SendMessageW(hWnd, DTM_SETSYSTEMTIME, GDT_VALID, reinterpret_cast<LPARAM>(&time));
}

bool bGetText(HWND hWnd, CNString& csText) {
  SYSTEMTIME time = {};
  SendMessageW(hWnd, DTM_GETSYSTEMTIME, 0, reinterpret_cast<LPARAM>(&time));
  csText = "";
  if (bIsTime(hWnd))
    csText.Printf("DateTimeWindow", "csText", "%02d:%02d:%02d", time.wHour, time.wMinute, time.wSecond);
  else
    AppendDate(time, csText);
  return true;
}

NativeEvent Notify(NativeControl&, NMHDR& message) { return ChangeEvent(message.code == DTN_DATETIMECHANGE); }

}  // namespace

const NativeKind g_DateTimeWindow = {.kind = ControlKind::DatePicker,
                                     .bField = true,
                                     .pPrepare = PrepareWithoutCaption,
                                     .pCreated = ShowSource,
                                     .pSetText = bSetText,
                                     .pGetText = bGetText,
                                     .pNotify = Notify};
