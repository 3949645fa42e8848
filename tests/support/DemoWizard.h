// The wizards of products/gallery and products/wizard97 with native windows, for tests: nothing that they do waits for
// a person or leaves the program, and they go on when they would end.
#pragma once

#include <memory>
#include <string>
#include <vector>

#include "window/Pictures.h"
#include "window/WindowView.h"
#include "wizard/COrbitWizard.h"

class DemoView : public CNWindowView {
 public:
  DemoView() : CNWindowView(GetModuleHandleW(nullptr), nullptr) {}
  int iShowMessage(const MessageText& message) override {
    messages.push_back(message.szText ? message.szText : "");
    return ANSWER_OK;
  }
  bool bChooseFolder(const char*, CNString&) override { return false; }
  bool bChooseFile(const char*, CNString&) override { return false; }
  bool bOpenLink(const char*, const char*) override { return true; }

  std::vector<std::string> messages;
};

class DemoWizard : public COrbitWizard {
 public:
  static constexpr const char* CLASS_NAME = "DemoWizardClass";

  explicit DemoWizard(DemoView& view) : COrbitWizard(view) {}
  ~DemoWizard() override { SetPictureFolder(nullptr); }

  // Loads products/NAME/NAME.txt and opens the window. Leaving makes it go on with the first dialog.
  bool bOpen(const std::string& name) {
    const std::string folder = FullPath(std::string(ORBIT_SOURCE_DIR) + "/products/" + name);
    m_pictures = folder + "\\pict";
    SetPictureFolder(m_pictures.c_str());
    return !iLoadMainList((folder + "\\" + name + ".txt").c_str()) && bOpenWindow();
  }
  // Once more, after it was closed.
  bool bOpenWindow() { return m_View.bOpenWindow(*this, {CLASS_NAME}); }
  void Show(int iDialog) {
    m_iCurrentDialog = m_iNextDialog = iDialog;
    iShowCurrentDialog();
  }
  HWND hWindow() const { return FindWindowA(CLASS_NAME, nullptr); }

 protected:
  int iOnCancel() override { return GoOn(); }
  int iOnExit() override { return GoOn(); }
  void EndProcess(int) override { m_View.iShowMessage({"the script ends the process", ""}); }

 private:
  static std::string FullPath(const std::string& path) {
    char full[MAX_PATH] = "";
    GetFullPathNameA(path.c_str(), MAX_PATH, full, nullptr);
    return full;
  }
  int GoOn() {
    m_iCurrentDialog = m_iNextDialog = 1;
    m_View.PostCommand(ID_SHOW_DIALOG);
    return EVERYTHING_IS_OK;
  }

  std::string m_pictures;
};
