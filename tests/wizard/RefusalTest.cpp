// What the engine refuses: each call comes back with its documented code and
// tells exactly one line, word for word.
#include "WizardFixture.h"

namespace {

class Refusal : public WizardTest {
 protected:
  void Expect(const std::string& line, bool bDocumented) {
    EXPECT_TRUE(bDocumented) << line;
    EXPECT_EQ(Logged(), Lines{line});
  }
  void Refused(const std::string& what, int iResult) {
    Expect("ERROR: COrbitWizard::" + what + " -> return PRECONDITIONS_NOT_VALID", iResult == PRECONDITIONS_NOT_VALID);
  }
  void Failed(const std::string& what, int iResult) {
    Expect("ERROR: COrbitWizard::" + what + " -> return FUNCTION_ERROR", iResult == FUNCTION_ERROR);
  }
};

TEST_F(Refusal, VariablesAndConditions) {
  CNString csValue("kept", 0), csNull, csEmpty("", 0);
  int iResult = 0;
  Refused("iSetVariable -> !szVar", wizard.iSetVariable(nullptr, ""));
  Refused("iSetVariable -> !*szVar ", wizard.iSetVariable("", ""));
  Refused("iSetVariable -> !szValue ", wizard.iSetVariable("a", nullptr));
  Refused("iSetVariable -> !*szVar ", wizard.iSetField("", "x"));
  Refused("iGetVariable -> !szVar", wizard.iGetVariable(nullptr, 0, csValue));
  Refused("iGetVariable -> !*szVar ", wizard.iGetVariable("", 0, csValue));
  Refused("iCalculateValue -> !szText", wizard.iCalculateValue(nullptr, csValue, 0));
  Refused("iCalculateValue -> !*szText ", wizard.iCalculateValue("", csValue, 0));
  Expect(
      "ERROR: COrbitWizard::iGetVariable -> !szValue  -> return "
      "POSTCONDITIONS_NOT_VALID",
      wizard.iGetVariable("missing", 0, csValue) == 2);
  EXPECT_STREQ(csValue.Text(), "kept");
  EXPECT_NE(wizard.Value("win_ver"), "");
  Refused("iReplaceVarWithText -> !szText", wizard.iReplaceVarWithText(csNull));
  Refused("iReplaceVarWithText -> !*szText", wizard.iReplaceVarWithText(csEmpty));
  Refused("iEvaluateExpression -> !szText", wizard.iEvaluateExpression(nullptr, 5, &iResult));
  EXPECT_EQ(iResult, -1);
  Failed("iEvaluateAtom -> !szVar1", wizard.iEvaluateAtom(nullptr, "x", 0, nullptr));
  Failed("iEvaluateAtom -> !szVar2", wizard.iEvaluateAtom("x", nullptr, 0, nullptr));
  Failed("iEvaluateAtom -> !*szVar1", wizard.iEvaluateAtom("", "", 0, nullptr));
}

TEST_F(Refusal, Commands) {
  int iResult = 0;
  const auto call = [&](const char* szName, const char* szParam) {
    iResult = -7;
    const int iCode = wizard.COrbitWizard::iExecuteFunction(szName, szParam, 0, &iResult, nullptr);
    return iResult == COMMAND_FAILED ? iCode : -7;
  };
  Failed("iExecuteCommand -> !szCommand", wizard.iExecuteCommand(nullptr, 0, &iResult));
  Failed("iExecuteCommand -> !*szCommand", wizard.iExecuteCommand("", 0, nullptr));
  EXPECT_EQ(iResult, COMMAND_FAILED);
  Expect("EXIT: COrbitWizard::iExecuteCommand -> return FUNCTION_ERROR", wizard.iExecuteCommand(" ", 0, &iResult) == 9);
  Refused("iExecuteFunction -> !szCommand", call(nullptr, ""));
  Refused("iExecuteFunction -> !*szCommand", call("", ""));
  Refused("iExecuteFunction -> !szParam", call("Next", nullptr));
  for (const std::string name : {"HideWizard", "ShowWizard", "EnableControl"})  // without a window
    Failed("iExecuteFunction -> i" + name, call(name.c_str(), "none"));
  Expect("ERROR: COrbitWizard::iShowMessageBox -> ! -> return 0", !wizard.iShowMessageBox(nullptr, MessageIcon::Error));
}

TEST_F(Refusal, LoadingAndMovingWithoutAScript) {
  CNString csChoice;
  Refused("iLoadMainList -> !szFileName | !*szFileName", wizard.iLoadMainList(nullptr));
  Refused("iLoadMainList -> !szFileName | !*szFileName", wizard.iLoadMainList(""));
  Refused("iLoadMainListBuffer -> !szBuffer", wizard.iLoadMainListBuffer(nullptr));
  Refused("iLoadMainListBuffer -> !pDialog", wizard.iLoadMainListBuffer("DIALOG1\nBEGIN\nEND\nEND_DIALOG1"));
  Refused("iExecuteWizard -> !szScript || !*szScript", wizard.iExecuteWizard("", 0));
  Failed("iLoadMainList -> !file.Open (no such file)", wizard.iExecuteWizard("no such file", 0));
  EXPECT_EQ(Events(), Lines{"message Error|Error - could not open file! (no such file) -> 1"});
  folder.Write("empty.txt", "");
  for (const char* szText : {"empty.txt", "// DIALOG1\n"})
    Expect(
        "ERROR: COrbitWizard::iLoadMainList -> !m_Dialogs.Size() -> return "
        "SYNTAX_ERROR",
        wizard.iLoadMainList(szText) == SYNTAX_ERROR);
  Failed("iShowCurrentDialog -> !pDialog", wizard.iShowCurrentDialog());
  Refused("iNextDialog -> !m_pWizDialogInfo", wizard.iNextDialog());
  Refused("iPreviousDialog -> !hDlg", wizard.iPreviousDialog());
  Refused("iSaveVarFromCurrentDlg -> !pWizDialogInfo", wizard.iSaveVarFromCurrentDlg(nullptr));
  Refused("iTranslateKeyAccelerators -> !m_hDlg", wizard.iTranslateKeyAccelerators('K', 0));
  Refused("iGetDirectoryDialog -> !szTitle || !*szTitle", wizard.iGetDirectoryDialog("", csChoice));
  Refused("iGetFileDialog -> !hDlg", wizard.iGetFileDialog("Title", csChoice));
  Expect(
      "ERROR: COrbitWizard::CWSetWindowText -> !szControlName || "
      "!*szControlName -> return FALSE",
      !wizard.CWSetWindowText("", "x"));
  Expect(
      "ERROR: COrbitWizard::CWSendMessage -> !szControlName || "
      "!*szControlName -> return -1",
      wizard.CWSendMessage(nullptr, 1, 2, 3) == -1);
  EXPECT_EQ(wizard.CWSendMessage("none", 1, 2, 3), -1);
}

TEST_F(Refusal, Registry) {
  const OsRegKey root = OS_HKEY_CURRENT_USER;
  const char* const szKey = "Software\\OrbitSetupTest\\None";
  CNCharArray names;
  char szValue[512];
  Refused("iReadRegistryKey -> !hKeyName", wizard.iReadRegistryKey(nullptr, szKey, "v", szValue));
  Refused("iReadRegistryKey -> !szSubkey || !*szSubkey", wizard.iReadRegistryKey(root, "", "v", szValue));
  Refused("iReadRegistryKey -> !szValue", wizard.iReadRegistryKey(root, szKey, "v", nullptr));
  Refused("iWriteRegistryKey -> !hKeyName", wizard.iWriteRegistryKey(nullptr, szKey, "v", "", nullptr));
  Refused("iWriteRegistryKey -> !szSubkey || !*szSubkey", wizard.iWriteRegistryKey(root, nullptr, "v", "", nullptr));
  Refused("iWriteRegistryKey -> !szValue", wizard.iWriteRegistryKey(root, szKey, "v", nullptr, nullptr));
  Refused("iDeleteRegistryKey -> !hKeyName", wizard.iDeleteRegistryKey(nullptr, szKey));
  Refused("iDeleteRegistryKey -> !szSubkey || !*szSubkey", wizard.iDeleteRegistryKey(root, ""));
  Refused("iDeleteRegistryValue -> !hKeyName", wizard.iDeleteRegistryValue(nullptr, szKey, "v"));
  Refused("iDeleteRegistryValue -> !szSubkey || !*szSubkey", wizard.iDeleteRegistryValue(root, "", "v"));
  Refused("iDeleteRegistryValue -> !szKey || !*szKey", wizard.iDeleteRegistryValue(root, szKey, ""));
  Refused("iEnumRegistryKey -> !hKeyName", wizard.iEnumRegistryKey(nullptr, szKey, names));
  Refused("iEnumRegistryKey -> !szSubkey || !*szSubkey", wizard.iEnumRegistryKey(root, "", names));
}

}  // namespace
