// The wizard engine. It loads a wizard script, keeps its variables, evaluates its conditions, runs its commands and
// walks through its dialogs. It reaches the screen only through a WizardView. Specialised wizards derive from it and
// add commands by overriding iExecuteFunction.
//
// Everything runs on the thread of the view's iRun, except where a member says "any thread".
#pragma once

#include <atomic>
#include <memory>

#include "controls/DialogInfo.h"
#include "foundation/ResultCodes.h"
#include "foundation/os/OsRegistry.h"
#include "wizard/WizardView.h"

class COrbitWizard : public WizardEvents {
 public:
  // The view must outlive the wizard.
  explicit COrbitWizard(WizardView& view);
  ~COrbitWizard() override;
  COrbitWizard(const COrbitWizard&) = delete;
  COrbitWizard& operator=(const COrbitWizard&) = delete;

  // ---- the whole run ----
  // Loads szScript (text or file name), opens the window of a class of its own and shows dialogs until the wizard ends.
  // iIconResource is a resource number of the program, 0 for its own icon. Returns 0, or the loader's result.
  int iExecuteWizard(const char* szScript, int iIconResource);
  // Opens the window (class szClassName), shows the first dialog of the loaded script and runs until the window closes.
  int iRunWindow(const char* szClassName, int iIconResource);
  // Ends the wizard with ID_EXIT. Any thread.
  void QuitWizard();

  // ---- loading (OrbitLoader.cpp) ----
  // The argument is a script's text when it contains the word "DIALOG", else the name of a script file.
  // Returns 0, 1 (null or empty), 9 (unreadable file, bad variable block) or 46 (no dialog).
  virtual int iLoadMainList(const char* szFileName);
  // Reads one block, from "DIALOG" to the end of "END_DIALOG", into the dialog appended last by iLoadMainList.
  virtual int iLoadMainListBuffer(const char* szBuffer);
  // Dialogs are numbered from 1 in load order. False (number untouched) for an unknown name.
  bool iGetDialogNumberByName(const char* szName, int* pNumber) const;
  int DialogCount() const { return m_Dialogs.Size(); }
  DialogInfo* GetDialog(int iNumber) const { return m_Dialogs[iNumber - 1]; }
  // Replaces face, size, weight and character set of every dialog's font; to be set before loading.
  void SetFontOverride(const DialogFont& font);
  // The file in which the window's place is kept from one run to the next, as "config.ini" of a program that is used
  // every day. Without one nothing is kept; to be set before the window opens.
  void SetConfigurationFile(const char* szPath) { m_csConfigurationFile = szPath; }

  // ---- variables (OrbitVariables.cpp) ----
  int iSetVariable(const char* szVar, const char* szValue);
  // Copies the value into csValue, or with cOperator '+' appends it, or with '-' takes its first digit as the number of
  // characters to cut off. Returns 0, 1, or POSTCONDITIONS_NOT_VALID for a missing variable.
  int iGetVariable(const char* szVar, int iFlag, CNString& csValue, char cOperator = 0);
  // The value, or "" (nothing logged).
  const char* szValue(const char* szVar);
  // Replaces every <%name%> in place; a missing name becomes one blank. A value's own markers are replaced in turn.
  // Returns 0, 1 (null or empty text), or FUNCTION_ERROR when variables refer to each other in a circle or the result
  // grows beyond reason: the markers that could not be replaced then stand in the text.
  int iReplaceVarWithText(CNString& csText);
  // The right side of an assignment: terms joined by '+' and '-'. Returns 0, 1 or 9.
  int iCalculateValue(const char* szText, CNString& csValue, int iFlag);
  CNVariables& Variables() { return m_Variables; }

  // ---- expressions and flow (OrbitExpression.cpp, OrbitFlow.cpp) ----
  // iWhich: 0 the dialog's flow text, 1 and 2 its two action texts, 3 szText (an event's command). The result tells the
  // window side what to do (CommandResult). Returns 0, 9 or 46.
  int iDecideNextDialog(int iDialogNumber, int iWhich, const char* szText, int* pCommandResult);
  // Evaluates the first line of the text: 1 true, 0 false, -1 undecidable. Returns 0 or 1.
  // At most MAX_NESTING parentheses may stand within each other.
  int iEvaluateExpression(const char* szText, int iLength, int* pResult);
  // The operands are literals (beginning with a double quote) or names of variables. Returns 0 or 9.
  // iOperator: 0 "==", 1 "!=", 2 ">", 3 ">=", 4 "<", 5 "<=", 6 a command call, 7 "&&", 8 "||".
  int iEvaluateAtom(const char* szVar1, const char* szVar2, int iOperator, int* pResult);

  // ---- commands (OrbitCommands.cpp) ----
  // Runs one command line. Returns 0 or 9; the command result starts as 9.
  int iExecuteCommand(const char* szCommand, int iFlag, int* pCommandResult);
  // Runs one named command; szParam is the text between the parentheses, pOutput an optional text for commands that
  // produce one. A subclass tests its own names first and hands unknown ones to this base class or refuses them.
  virtual int iExecuteFunction(const char* szCommand, const char* szParam, int iFlag, int* pCommandResult,
                               CNString* pOutput);
  // Whether this base class has a command of that name: it ignores the ones that it does not know.
  static bool bIsBuiltIn(const char* szCommand);

  // ---- navigation (OrbitNavigation.cpp) ----
  int iNextDialog();
  int iPreviousDialog();
  // Turns a control's notification into an event, runs it and acts on its result.
  int iProcessID(BaseControl& control, int iNotification);
  // Runs a command that the control stands for and acts on its result. Nothing for an empty one.
  int iProcessCommand(BaseControl& control, const CNString& csCommand);
  virtual int iProcessDecideNextDialogAction(int iResult);
  // Writes the fields of the dialog into their variables: edit fields, rich edits that REMEMBER, combos, then the rest.
  int iSaveVarFromCurrentDlg(DialogInfo* pWizDialogInfo);
  // Shows the dialog that is now current: controls, before-drawing commands, texts, drawing, after-drawing commands.
  int iShowCurrentDialog();
  int CurrentDialogNumber() const { return m_iCurrentDialog; }
  int HistoryCount() const { return m_iNumLastDialog; }
  DialogInfo* CurrentDialog() const { return m_pWizDialogInfo; }

  // ---- fields: a variable and, when a control of its name is shown, what that control shows (OrbitControls.cpp) ----
  // Sets the variable, and the text of the field of that name when one is shown. Returns what iSetVariable returns.
  int iSetField(const char* szName, const char* szValue);
  // The field's present text when one of that name is shown, else the variable's value. False (csValue untouched) when
  // there is neither.
  bool csGetField(const char* szName, CNString& csValue);

  // ---- controls of the current dialog, by variable name (OrbitControls.cpp); any thread ----
  // Null and false for a name that no control of the dialog has; only an empty name is logged.
  BaseControl* GetBaseControl(const char* szControlName) const;
  bool CWSetWindowText(const char* szControlName, const char* szText);
  bool CWGetWindowText(const char* szControlName, CNString& csText);
  bool CWSetProgress(const char* szControlName, int iPercent);
  // Sends the control's window a message of the system. Returns its answer, or -1 without such a control or window.
  intptr_t CWSendMessage(const char* szControlName, unsigned uMessage, uintptr_t wParam, intptr_t lParam);
  // Shows the MESSAGE_BOX control of that name of the current dialog, or of any dialog when the current one has none.
  // The icon and the buttons come from the box's flag words (README.md); an icon other than None wins over them.
  // Returns the answer, 0 when there is no such box.
  int iShowMessageBox(const char* szControlName, MessageIcon icon);
  // Let the user choose; the text is where to start, then the choice. Not for other threads. Return 0, 1 (no title, no
  // window), or 2 (text untouched) when the user cancelled.
  int iGetDirectoryDialog(const char* szTitle, CNString& csFolder);
  int iGetFileDialog(const char* szTitle, CNString& csFile);

  // ---- registry helpers (OrbitRegistry.cpp); any thread ----
  // Return 0, PRECONDITIONS_NOT_VALID or REG_KEY_ERROR. szValue of the read holds 512 bytes.
  static int iReadRegistryKey(OsRegKey hKeyName, const char* szSubkey, const char* szName, char* szValue);
  static int iWriteRegistryKey(OsRegKey hKeyName, const char* szSubkey, const char* szName, const char* szValue,
                               const char* szType);
  static int iDeleteRegistryKey(OsRegKey hKeyName, const char* szSubkey);
  static int iDeleteRegistryValue(OsRegKey hKeyName, const char* szSubkey, const char* szKey);
  static int iEnumRegistryKey(OsRegKey hKeyName, const char* szSubkey, CNCharArray& names);

  // ---- WizardEvents ----
  void OnCommand(int iID) override;
  void OnControl(BaseControl& control, int iNotification) override;
  void OnItem(BaseControl& item) override;
  int iTranslateKeyAccelerators(int iKey, unsigned uModifiers) override;
  void OnCloseRequest() override;
  bool bHoldsQuit() override { return false; }
  // The script's variable "hold_reason".
  const char* szHoldReason() override;
  // Ends the wizard with ID_EXIT.
  void OnEndSession() override;

  // How the wizard ended: ID_NEXT (ran out of dialogs), ID_CANCEL, ID_EXIT; 0 while it runs.
  int EndedBy() const { return m_iEndedBy; }

 protected:
  // Window-event operations that a specialised wizard replaces.
  virtual int iOnOK();
  virtual int iOnCancel();
  virtual int iOnExit();
  // The list of recent files, for wizards that keep one; this class has none. Return a result code.
  virtual int iFillRecentFiles(const char* szParam, int* pCommandResult);
  virtual int iOpenRecentFile(const char* szParam, int* pCommandResult);
  // Reads the whole file. Returns 0, or 9 after telling the user.
  virtual int iReadScriptFile(const char* szFileName, CNString& csText);
  // Ends the process after a block-structure error; tests replace it.
  virtual void EndProcess(int iExitCode);

  WizardView& m_View;
  CNVariables m_Variables;
  CNArray<DialogInfo> m_Dialogs;
  DialogInfo* m_pWizDialogInfo = nullptr;  // the current dialog, owned by m_Dialogs
  int m_iCurrentDialog = 1;                // number of the current dialog
  int m_iNextDialog = 1;                   // the next-dialog counter; -1: the wizard ends
  int m_iEndedBy = 0;
  bool m_bModeless = false;
  bool m_bOutOfDialogs = false;  // the ID_CANCEL that is under way means that the flow ended, not that the user cancels

 private:
  static const int MAX_HISTORY = 500;             // the oldest entry makes room for the 501st
  static const int MAX_NESTING = 100;             // of conditions, of flow blocks
  static const long MAX_VALUE_LENGTH = 1L << 20;  // of a variable that an assignment or a substitution makes

  struct Substitution;  // the state of one iReplaceVarWithText
  struct FlowRun;       // the state of one iDecideNextDialog
  struct FlowWord;
  struct Expression;  // the state of one iEvaluateExpression
  struct Operand;
  struct BuiltIn;  // one row of the built-in commands

  // Loader.
  int iLoadVariables(const char** ppText, const char* pEnd);
  int iCheckVariableLines(const char* pText, const char* pEnd);
  int iStoreVariables(const char* pText, const char* pEnd);
  int iLoadDialogs(const char* pText, const char* pEnd);
  int iReadDialog(DialogInfo& dialog, const char* pText, const char* pEnd);
  const char* pReadDialogName(DialogInfo& dialog, const char* pText, const char* pLineEnd);
  void ReadDialogHeader(DialogInfo& dialog, const char* pText, const char* pLineEnd);
  void AdjustCaptionHeight(DialogInfo& dialog);
  const char* pReadDialogFont(DialogInfo& dialog, const char* pText, const char* pEnd);
  void ReadDialogBody(DialogInfo& dialog, const char* pText, const char* pEnd);
  int iFatal(const char* szFormat, int iDialogs);

  // Variables.
  bool bExpand(Substitution& run, const char* pText, const char* pEnd, int iDepth);
  const char* pReplaceMarker(Substitution& run, const char* pMarker, const char* pNameEnd, int iDepth);
  int iRefuseLength();
  const char* pAddTerm(const char* pText, const char* pEnd, char cOperator, CNString& csValue);

  // Expressions.
  void ParseOr(Expression& run, Operand& out);
  void ParseAnd(Expression& run, Operand& out);
  void ParseComparison(Expression& run, Operand& out);
  void ParseOperand(Expression& run, Operand& out);
  void ParseGroup(Expression& run, Operand& out);
  void ParseName(Expression& run, Operand& out);
  bool bIsTrue(const Operand& operand);
  void PrepareOperand(const char* szOperand, CNString& csValue);

  // Flow.
  void RunFlow(FlowRun& run);
  void RunStatement(FlowRun& run, bool bExecute);
  void RunBlock(FlowRun& run, bool bExecute);
  void RunCommand(FlowRun& run, bool bExecute);
  void TakeResult(FlowRun& run, int iCode, int iResult);
  void MoveAfterNext(FlowRun& run);
  void FailFlow(FlowRun& run, int iCode);
  void FlowIf(FlowRun& run, bool bExecute);
  void FlowSwitch(FlowRun& run, bool bExecute);
  bool bFlowCase(FlowRun& run, bool bExecute, const char* pExpression, const char* pExpressionEnd);
  void FlowContinue(FlowRun& run, bool bExecute);
  void FlowEndDialog(FlowRun& run, bool bExecute);
  void FlowFinish(FlowRun& run, bool bExecute);
  static const FlowWord FLOW_WORDS[];

  // Commands.
  int iJumpStatement(const char* szText, int* pCommandResult);
  int iJumpCall(const char* szParam, int* pCommandResult);
  int iRefuseJump(const char* szLine);
  int iAssign(const char* szName, const char* szExpression, int iFlag, int* pCommandResult);
  int iAppend(const char* szName, CNString& csTail, bool* pAppended);
  int iCall(const char* szName, const char* szText, int iFlag, int* pCommandResult);
  int iMessageBoxCommand(const char* szParam, int* pCommandResult);
  int iShowBox(const class CNMessageBox& box, MessageIcon icon);
  void ReadInlineBox(const char* szParam, class CNMessageBox& box);
  class CNMessageBox* pFindMessageBox(const char* szName) const;
  bool bOperandValue(const char* pText, const char* pEnd, CNString& csValue);
  void CompareEnds(const char* szParam, int iWhenEqual, int* pCommandResult);
  int iSetControlState(const char* szParam, bool (WizardView::*pSet)(const BaseControl&, bool), bool bOn, int* pResult);
  void VisitLink();
  int iOpenLink(const char* szParam, int* pCommandResult);
  int iFillRecent(const char* szParam, int* pCommandResult, CNString* pOutput);
  int iOpenRecent(const char* szParam, int* pCommandResult, CNString* pOutput);
  int iRecordMacro(const char* szParam, int* pCommandResult, CNString* pOutput);
  int iPlayMacro(const char* szParam, int* pCommandResult, CNString* pOutput);
  int iLinkNext(const char* szParam, int* pCommandResult, CNString* pOutput);
  int iLinkWeb(const char* szParam, int* pCommandResult, CNString* pOutput);
  int iLinkMail(const char* szParam, int* pCommandResult, CNString* pOutput);
  int iPostNext(const char* szParam, int* pCommandResult, CNString* pOutput);
  int iPostBack(const char* szParam, int* pCommandResult, CNString* pOutput);
  int iEnableControl(const char* szParam, int* pCommandResult, CNString* pOutput);
  int iDisableControl(const char* szParam, int* pCommandResult, CNString* pOutput);
  int iShowControl(const char* szParam, int* pCommandResult, CNString* pOutput);
  int iHideControl(const char* szParam, int* pCommandResult, CNString* pOutput);
  int iHideWizard(const char* szParam, int* pCommandResult, CNString* pOutput);
  int iShowWizard(const char* szParam, int* pCommandResult, CNString* pOutput);
  int iEndsWith(const char* szParam, int* pCommandResult, CNString* pOutput);
  int iNotEndsWith(const char* szParam, int* pCommandResult, CNString* pOutput);
  int iStrlen(const char* szParam, int* pCommandResult, CNString* pOutput);
  int iSetVarAndQuit(const char* szParam, int* pCommandResult, CNString* pOutput);
  static const BuiltIn BUILT_INS[];
  static const BuiltIn* pFindBuiltIn(const char* szCommand);

  // Navigation.
  void PushHistory(int iDialog);
  void PopHistory();
  void SendOrPost(int iID);
  int iShowDecided();
  int iOutOfDialogs();
  int iOnEscape();
  int iRunAction(int iWhich);
  int iLeave(int iEndedBy);
  void FillControls();
  void FillControl(const BaseControl& control, CNString& csBefore);
  void CheckItems(const CNItemControl& control);
  void SaveItems(const CNItemControl& control);
  void SaveCells(const class CNListView& list);
  void KeepChoice(CNItem& item);
  static BaseControl* pAccelerator(const DialogInfo& dialog, ControlKind kind, const struct KeyChord& chord);
  bool bShownText(const BaseControl& control, CNString& csText);
  void Substitute(const CNString& csIn, CNString& csOut);
  void SaveKind(const DialogInfo& dialog, bool (*pIsKind)(const BaseControl& control));
  void UncheckPartners(const BaseControl& control);
  BaseControl* pFieldShown(const char* szName) const;

  ScriptReport m_Report;
  CNString m_csScript;    // the cleaned script text that positions and dialogs refer to while loading
  CNString m_csFileName;  // null for a script given as text
  CNString m_csConfigurationFile;
  DialogFont m_FontOverride;
  bool m_bHasFontOverride = false;
  int m_LastDialogs[MAX_HISTORY] = {};
  int m_iNumLastDialog = 0;
  BaseControl* m_pEventControl = nullptr;         // the control whose event is being run
  bool m_bShowing = false;                        // commands are posted, so that showing a dialog does not nest
  unsigned m_uShowings = 0;                       // how often a dialog was shown
  std::unique_ptr<CNVariables> m_pDialogNumbers;  // the number of each dialog by its name; the first of a name counts
  CNArray<CNString> m_FilledTexts;  // what FillControl put into each control of the current dialog, in their order
  std::atomic<DialogInfo*> m_pShownDialog{nullptr};  // m_pWizDialogInfo for other threads
};
