// A page described by a few script lines, shown by a real native view whose events are recorded.
#pragma once

#include <gtest/gtest.h>

#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "window/Handles.h"
#include "window/Win32View.h"

// A dialog description as the loader makes it.
struct Page {
  // szHeader: "x y w h, FLAGS"; szControls: the lines between BEGIN and END.
  Page(DialogKind kind, const char* szHeader, const char* szControls, double dScale = 1.0);
  BaseControl& operator[](const char* szName) const;

  DialogInfo info;

 private:
  CNVariables m_Variables;
  ScriptReport m_Report{nullptr};
  std::string m_Controls;
};

// Writes down what the view tells: "command 101", "name 0" (a control and its notification), "item CALL", "close".
class RecordingWizard : public WizardEvents {
 public:
  void OnCommand(int iID) override { Record("command " + std::to_string(iID)); }
  void OnControl(BaseControl& control, int iNotification) override {
    Record(std::string(control.m_csName.Text()) + " " + std::to_string(iNotification));
  }
  void OnItem(BaseControl& item) override {
    CNString csCommand;
    ItemCommand(item, csCommand);
    Record(std::string("item ") + csCommand.Text());
  }
  int iTranslateKeyAccelerators(int iKey, unsigned uModifiers) override {
    return onKey && onKey(iKey, uModifiers) ? EVERYTHING_IS_OK : FUNCTION_ERROR;
  }
  void OnCloseRequest() override { Record("close"); }
  bool bHoldsQuit() override { return holdsQuit; }
  void OnEndSession() override { Record("end session"); }

  std::vector<std::string> events;
  std::function<void(const std::string& event)> onEvent;
  std::function<bool(int iKey, unsigned uModifiers)> onKey;  // true: an accelerator takes the key
  bool holdsQuit = false;

 private:
  void Record(const std::string& event) {
    events.push_back(event);
    if (onEvent) onEvent(event);
  }
};

// Handles this thread's messages until the condition holds. False when it does not come within half a minute, which is
// long for any machine: nothing waits that long when all goes well.
bool bWaitFor(const std::function<bool()>& condition);
// The message box or chooser with that caption, when it is ready to be used; null when none comes. Threads may wait.
HWND hWaitForDialog(const wchar_t* szCaption);

// One wizard with its native view. The window is opened by the constructor.
class Screen {
 public:
  enum class Layout { NotSaid, Pixels, Scaled };
  explicit Screen(WizardView* pOwner = nullptr, const char* szConfigurationFile = nullptr,
                  Layout layout = Layout::NotSaid, bool bModeless = false);

  // Shows it with its items' texts filled in, as the wizard does.
  void Show(Page& page);
  void Fill(const BaseControl& control);
  // What the view says of a control's value.
  std::string Value(const BaseControl& control) const;
  // The window of a control, in whatever container.
  HWND hOf(const BaseControl& control) const;
  // Finds windows as any other program would: the top-level window by its class, a control by its text or class.
  HWND hWindow() const;
  HWND hChild(const wchar_t* szText) const;
  HWND hChildOfClass(const wchar_t* szClass) const;
  // Puts a key into the queue for whatever has the keyboard.
  void Key(WPARAM wKey);
  // Presses the keys one after the other, each when the one before it has been handled.
  void Press(std::initializer_list<WPARAM> keys);
  // Handles everything that is queued, by running the view's own loop until a last command arrives.
  void RunQueued();
  std::vector<std::string> TakeEvents();

  RecordingWizard wizard;
  std::unique_ptr<WizardView> view;

 private:
  static const int END_OF_QUEUE = 500;
  std::string m_ClassName;
};

// One that shows a page.
struct ShownPage : Screen {
  explicit ShownPage(const std::string& controls, const char* szHeader = "0 0 400 300",
                     DialogKind kind = DialogKind::DialogSys)
      : page(kind, szHeader, controls.c_str()) {
    Show(page);
  }
  BaseControl& operator[](const char* szName) const { return page[szName]; }
  using Screen::hOf, Screen::Value;
  HWND hOf(const char* szName) const { return hOf(page[szName]); }
  std::string Value(const char* szName) const { return Value(page[szName]); }
  bool bSet(const char* szName, const char* szValue) { return view->bSetText(page[szName], szValue); }

  Page page;
};

std::wstring TextOf(HWND hWnd);
// The colour of a window's pixel as it is on the screen.
COLORREF PixelOf(HWND hWnd, int x, int y);
// Writes a picture into the folder pict, to be deleted by the caller: csPath. It is of 4 by 2 pixels: red on the left
// half, the ground colour 204,204,204 on the right. File lines run upwards.
void WritePicture(const char* szName, CNString& csPath);
// A window's rectangle on the screen, or within another window's client area.
RECT AreaOf(HWND hWnd, HWND hWithin = nullptr);
SIZE ClientOf(HWND hWnd);
// "x y width height"; of a window: within its parent.
std::string PlaceText(const RECT& area);
std::string PlaceText(HWND hWnd);
// A control by its place in the dialog, as "x,y".
std::string PlaceName(const Screen& screen, HWND hWnd);
// Puts a press of the left button into the queue; at: in the window.
void Click(HWND hWnd, POINT at = {5, 5}, UINT uDown = WM_LBUTTONDOWN);
// The cursor that the window chooses for itself.
HCURSOR hCursorOver(HWND hWnd);
