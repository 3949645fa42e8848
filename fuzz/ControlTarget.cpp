// The control part of a dialog, at the memory's end and with a report; then the same written back and read again.
#include <algorithm>
#include <memory>

#include "Fuzz.h"
#include "controls/DialogInfo.h"
#include "controls/MessageSink.h"

namespace {

class SilentSink : public MessageSink {
 public:
  int iShowMessage(const MessageText& message) override {
    FUZZ_REQUIRE(message.szText != nullptr);
    return ANSWER_OK;
  }
};

std::string Read(const std::string& text, double dScale, bool bReport) {
  const std::unique_ptr<char[]> pTight(new char[text.size() + 1]());
  text.copy(pTight.get(), text.size());
  SilentSink sink;
  ScriptReport report(&sink);
  CNVariables variables;
  if (bReport) report.Setup(pTight.get(), "fuzz.txt");
  ScriptContext context{bReport ? &report : nullptr, &variables, dScale};
  DialogInfo dialog;
  dialog.ReadHeader(pTight.get(), pTight.get() + std::min(text.find('\n'), text.size()), context);
  dialog.ReadControls(pTight.get(), pTight.get() + text.size(), context);
  CNString csOut;
  for (int i = 0; i < dialog.m_Controls.Size(); i++) {
    dialog.m_Controls[i]->WriteControl(csOut);
    csOut.Concat("\n");
  }
  return csOut.Text();
}

}  // namespace

FUZZ_TARGET(control, input) {
  const std::string text = FuzzParts(input)[0];
  Read(text, 1.0, false);
  Read(Read(text, 1.0, true), 1.25, true);
}
