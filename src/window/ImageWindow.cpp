// Pictures. A CUSTOM one paints itself, with the dialog's background behind what its picture leaves out.
#include "window/NativeControls.h"
#include "wizard/WizardView.h"

namespace {

const wchar_t* const CUSTOM_CLASS = L"BitmapClass";

CNImage& Image(const NativeControl& native) { return static_cast<CNImage&>(native.Control()); }

void Paint(HWND hWnd, const NativeControl& native) {
  PAINTSTRUCT paint;
  const HDC hTarget = BeginPaint(hWnd, &paint);
  RECT client;
  GetClientRect(hWnd, &client);
  {
    BufferedDC buffer(hTarget, client);
    native.FillGround(buffer.Get(), client);
    if (native.m_pPicture) {
      const SIZE size = native.m_pPicture->Size();
      native.m_pPicture->Draw(buffer.Get(), Image(native).m_bStretch ? client : RECT{0, 0, size.cx, size.cy});
    }
  }
  EndPaint(hWnd, &paint);
}

// The picture window's own notifications, which only one with an action sends: no script waits for the others.
void Notify(HWND hWnd, const NativeControl& native, int iNotification) {
  if (!native.Control().m_csAction.Ptr()) return;
  SendMessageW(GetParent(hWnd), WM_COMMAND, MAKEWPARAM(GetDlgCtrlID(hWnd), iNotification),
               reinterpret_cast<LPARAM>(hWnd));
}

// The mouse is inside from the first movement until the system says that it left.
void NoticeMouseIn(HWND hWnd, const NativeControl& native) {
  TRACKMOUSEEVENT track = {sizeof(track), TME_QUERY, hWnd, 0};
  if (TrackMouseEvent(&track) && track.dwFlags & TME_LEAVE) return;
  track = {sizeof(track), TME_LEAVE, hWnd, 0};
  TrackMouseEvent(&track);
  Notify(hWnd, native, NOTIFY_MOUSE_IN);
}

struct MouseRow {
  UINT uMessage;
  int iNotification;
};

const MouseRow MOUSE_ROWS[] = {
    {WM_MOUSELEAVE, NOTIFY_MOUSE_OUT},
    {WM_LBUTTONUP, NOTIFY_MOUSE_UP},
    {WM_LBUTTONDOWN, NOTIFY_MOUSE_DOWN},
};

LRESULT CALLBACK PictureProc(HWND hWnd, UINT uMessage, WPARAM wParam, LPARAM lParam) {
  const NativeControl* pNative = NativeControl::pFromWindow(hWnd);
  if (pNative && uMessage == WM_PAINT) return Paint(hWnd, *pNative), 0;
  if (uMessage == WM_ERASEBKGND) return TRUE;  // Paint covers everything
  if (pNative && uMessage == WM_MOUSEMOVE) NoticeMouseIn(hWnd, *pNative);
  for (const MouseRow& row : MOUSE_ROWS)
    if (pNative && uMessage == row.uMessage) return Notify(hWnd, *pNative, row.iNotification), 0;
  return DefWindowProcW(hWnd, uMessage, wParam, lParam);
}

// Once per process; a second registration is refused, which is as good.
void RegisterCustomClass(HINSTANCE hInstance) {
  WNDCLASSEXW description = {};
  description.cbSize = sizeof(description);
  description.style = CS_VREDRAW | CS_HREDRAW;
  description.lpfnWndProc = PictureProc;
  description.hInstance = hInstance;
  description.hCursor = LoadCursorW(nullptr, IDC_ARROW);
  description.lpszClassName = CUSTOM_CLASS;
  RegisterClassExW(&description);
}

void Prepare(NativeControl& native, CREATESTRUCTW& window) {
  const CNImage& image = Image(native);
  native.m_pPicture.reset(new Picture);
  // Only a picture that paints itself can leave a colour out.
  const ControlColor transparent = image.m_bCustom ? image.m_Transparent : ControlColor();
  if (!native.m_pPicture->bLoad(window.hInstance, image.m_csPicture.Ptr(), transparent)) native.m_pPicture.reset();
  if (native.m_pPicture && !window.cx && !window.cy) {
    window.cx = native.m_pPicture->Size().cx;
    window.cy = native.m_pPicture->Size().cy;
  }
  if (image.m_bCustom)
    RegisterCustomClass(window.hInstance);
  else
    window.style |= SS_BITMAP | (image.m_bStretch ? SS_REALSIZECONTROL : 0);
}

// A copy that the window has made for itself, of a picture with transparency, and leaves behind.
struct ShownCopy : NativeState {
  explicit ShownCopy(HBITMAP hCopy) : bitmap(hCopy) {}
  OwnedBitmap bitmap;
};

void Created(NativeControl& native) {
  if (Image(native).m_bCustom || !native.m_pPicture) return;
  const HBITMAP hBitmap = native.m_pPicture->hBitmap();
  SendMessageW(native.hWnd(), STM_SETIMAGE, IMAGE_BITMAP, reinterpret_cast<LPARAM>(hBitmap));
  const auto hShown = reinterpret_cast<HBITMAP>(SendMessageW(native.hWnd(), STM_GETIMAGE, IMAGE_BITMAP, 0));
  if (hShown != hBitmap) native.m_pState.reset(new ShownCopy(hShown));
}

// A caption is no part of a picture.
bool bRefuseText(HWND, const char*) { return false; }

int Notification(NativeControl&, int iCode) {
  return iCode >= NOTIFY_MOUSE_IN && iCode <= NOTIFY_MOUSE_DOWN ? iCode : NativeKind::IGNORED;
}

}  // namespace

const NativeKind g_ImageWindow = {.kind = ControlKind::Image,
                                  .dwRemovedStyle = WS_TABSTOP,
                                  .pPrepare = Prepare,
                                  .pCreated = Created,
                                  .pSetText = bRefuseText,
                                  .pNotification = Notification};
