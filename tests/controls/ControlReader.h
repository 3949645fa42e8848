// Reads the control part of a dialog from a text that ends where its memory ends, so that the sanitizers see a reader
// that goes too far, and keeps what was reported.
#pragma once

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "controls/DialogInfo.h"
#include "controls/Kinds.h"

class RecordingSink : public MessageSink {
 public:
  int iShowMessage(const MessageText& message) override {
    shown.push_back(std::string(message.szCaption) + "|" + message.szText);
    EXPECT_FALSE(message.bOwned);
    EXPECT_EQ(message.buttons, MessageButtons::Ok);
    return ANSWER_OK;
  }
  std::vector<std::string> shown;
};

class ControlReader {
 public:
  explicit ControlReader(const std::string& text, double dScale = 1.0, bool bVariables = true)
      : report(&sink), m_text(text.begin(), text.end()), m_terminated(text) {
    report.Setup(m_terminated.c_str(), "setup.txt");
    context = {&report, bVariables ? &variables : nullptr, dScale};
  }

  // Reads from memory without a terminator; faults have no line then.
  ControlReader& ReadTight() {
    dialog.ReadControls(m_text.data(), m_text.data() + m_text.size(), context);
    return *this;
  }
  ControlReader& Read() {
    dialog.ReadControls(m_terminated.data(), m_terminated.data() + m_terminated.size(), context);
    return *this;
  }
  int Count() const { return dialog.m_Controls.Size(); }
  BaseControl& Control(int i = 0) const { return *dialog.m_Controls[i]; }
  template <class T>
  T& As(int i = 0) const {
    return static_cast<T&>(Control(i));
  }
  // All controls written back, one line each.
  std::string Dump() const {
    CNString csOut;
    for (int i = 0; i < Count(); i++) {
      if (i > 0) csOut.Concat("\n");
      Control(i).WriteControl(csOut);
    }
    return csOut.Text();
  }

  RecordingSink sink;
  ScriptReport report;
  CNVariables variables;
  ScriptContext context;
  DialogInfo dialog;

 private:
  std::vector<char> m_text;
  std::string m_terminated;
};

inline std::string TextOf(const CNString& cs) { return cs.Ptr() ? cs.Ptr() : "(null)"; }
