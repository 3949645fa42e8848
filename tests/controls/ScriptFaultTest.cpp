// Faults of a script: the exact message, the line, and what is kept of the control.
#include "ControlReader.h"
#include "support/TestFolder.h"

namespace {

struct FaultRow {
  const char* szLine;  // the third of the script
  const char* szMessage;
  const char* szWritten;
};

TEST(ScriptFault, IsReportedOnceWithItsLineAndTheControlKept) {
  const std::string at = "syntax error|U datoteci setup.txt, u liniji 3,";
  const FaultRow rows[] = {
      {"BUTTON 'b \"Go\" 1 2 3 4", "nedostaje apostrof!", "BUTTON \"Go\" 1 2 3 4"},
      {"BUTTON 'b' \"Go 1 2 3 4, DEFAULT", "nedostaje navodnik!", "BUTTON 'b' 1 2 3 4,DEFAULT"},
      {"BUTTON 'b' \"Go\" \"on 1 2 3 4", "nedostaje navodnik!", "BUTTON 'b' \"Go\" 1 2 3 4"},
      {"BUTTON 'b' \"Go\\\" 1 2 3 4", "nedostaje navodnik!", "BUTTON 'b' 1 2 3 4"},
      {"LIST_FIELD 'l' \"a\" \"b 1 2 3 4", "nedostaje navodnik!", "LIST_FIELD 'l' \"a\" 1 2 3 4"},
      {"BUTTON 'b' \"Go\" TOOLTIP 1 2 3 4", "nedostaje apostrof!", "BUTTON 'b' \"Go\" 1 2 3 4"},
      {"BUTTON 'b' \"Go\" TOOLTIP 'x 1 2 3 4", "nedostaje apostrof!", "BUTTON 'b' \"Go\" 1 2 3 4"},
      {"BUTTON 'b' \"Go\" 1 2 3 4, FOCUS ACTION: (Choose", "nedostaje zagrada!", "BUTTON 'b' \"Go\" 1 2 3 4,FOCUS"},
      {"BUTTON 'b' \"Go\" ID_NEXTT 1 1 1 1", "pogresan ID, ili verzija Bafunpraik ne podrzava taj ID",
       "BUTTON 'b' \"Go\" 1 1 1 1"},
      {"BUTTON 'b' \"Go\" ID_NEXTT TOOLTIP 'x' 1 1 1 1", "pogresan ID, ili verzija Bafunpraik ne podrzava taj ID",
       "BUTTON 'b' \"Go\" TOOLTIP 'x' 1 1 1 1"},
      {"LISTVIEW 'v' 1 2 3 4", "nedostaje END_LISTVIEW!", "LISTVIEW 'v' 1 2 3 4\nEND_LISTVIEW"},
      {"FRAME 'v' 1 2 3 4", "nedostaje END_FRAME!", "FRAME 'v' 1 2 3 4"},
      {"MESSAGE_BOX 'm' \"x\"", "nedostaje END_MESSAGE_BOX!", "MESSAGE_BOX 'm' \"x\" 0 0 0 0\nEND_MESSAGE_BOX"},
  };
  for (const FaultRow& row : rows) {
    ControlReader reader(std::string("\n\n") + row.szLine + "\nPAGER 'p' 5 6 7 8");
    EXPECT_EQ(reader.Read().Dump(), std::string(row.szWritten) + "\nPAGER 'p' 5 6 7 8");
    EXPECT_EQ(reader.sink.shown, std::vector<std::string>{at + row.szMessage}) << row.szLine;
  }
}

TEST(ScriptFault, AMissingEndWordTakesNothingOfTheNextBlock) {
  ControlReader reader(
      "REBAR 'one' 1 2 3 4\nBAND\nREBAR 'two' 1 2 3 4\nBAND\nEND_REBAR\nMESSAGE_BOX 'm' \"x\"\n>lost\n"
      "MESSAGE_BOX 'n' \"y\"\n>kept\nEND_MESSAGE_BOX");
  reader.Read();
  ASSERT_EQ(reader.Count(), 4);
  EXPECT_EQ(reader.Control(0).pItemControl()->m_Items.Size(), 0);
  EXPECT_EQ(reader.Control(1).pItemControl()->m_Items.Size(), 1);
  EXPECT_EQ(TextOf(reader.As<CNMessageBox>(2).m_csText), "(null)");
  EXPECT_EQ(TextOf(reader.As<CNMessageBox>(3).m_csText), "kept");
  EXPECT_EQ(reader.report.FaultCount(), 2);
}

struct ReportRow {
  const char* szFile;
  bool bPosition;
  int iFault;
  const char* szMessage;
};

TEST(ScriptFault, MessageNamesWhatIsKnown) {
  const char szScript[] = "one\ntwo\nthree";
  const ReportRow rows[] = {
      {"a.txt", true, FAULT_COLON, "U datoteci a.txt, u liniji 3,nedostaje dvotocka!"},
      {"a.txt", false, FAULT_COMMA, "U datoteci a.txt,nedostaje zarez!"},
      {nullptr, true, FAULT_END_OF_SCRIPT, "U  u liniji 3,neocekivan kraj skripte!"},
      {nullptr, false, FAULT_MISSING_WORD_ALSO, "U nedostaje 100%d!"},
      {"a.txt", true, 9, "Greska je nedefinirana!"},
      {"a.txt", true, -1, "Greska je nedefinirana!"},
  };
  for (const ReportRow& row : rows) {
    RecordingSink sink;
    ScriptReport report(&sink);
    report.Setup(szScript, row.szFile);
    EXPECT_EQ(report.iReport(row.iFault, row.bPosition ? szScript + 9 : nullptr, "100%d"), 0);
    EXPECT_EQ(sink.shown, std::vector<std::string>{std::string("syntax error|") + row.szMessage});
  }
}

TEST(ScriptFault, APositionOutsideTheScriptHasNoLine) {
  const char szOther[] = "other";
  RecordingSink sink;
  ScriptReport report(&sink);
  report.Setup("one\ntwo", "a.txt");
  report.iReport(FAULT_ID, szOther);
  EXPECT_EQ(sink.shown[0], "syntax error|U datoteci a.txt,pogresan ID, ili verzija Bafunpraik ne podrzava taj ID");
}

TEST(ScriptFault, DiagnosticLines) {
  TestFolder folder;
  TestLog log(folder);
  ControlReader reader(
      "BUTTON\nWAVE  \nMESSAGE_BOX 'm' \"x\"\nother\nEND_MESSAGE_BOX\nTEXT_FIELD 1 2 3 4, BACKGROUND(300,0,-1)\n");
  reader.Read();
  EXPECT_EQ(log.Lines(), (std::vector<std::string>{
                             "ERROR: DialogInfo::AddButton -> !text -> return PRECONDITIONS_NOT_VALID",
                             "ERROR: DialogInfo::AddWave -> !text -> return PRECONDITIONS_NOT_VALID",
                             "ERROR: CNMessageBox -> !*szNextLine -> return PRECONDITIONS_NOT_VALID",
                             "EXIT: CNMessageBox::iReadScript -> return FUNCTION_ERROR",
                             "ERROR: color out of range : red=300, green=0, blue=-1",
                         }));
  ASSERT_EQ(reader.Count(), 2);
  EXPECT_EQ(reader.Control(1).m_Background.red, 44);
  EXPECT_EQ(reader.Control(1).m_Background.blue, 255);

  log.Clear();
  ControlReader bare("EDIT_FIELD 'e' 1 2 3 4\nREBAR 'r' 1 2 3 4\nEND_REBAR\nPAGER 'p' 1 2 3 4", 1.0, false);
  EXPECT_EQ(bare.Read().Count(), 1);
  int iID = 501, bGroup = 0;
  ScriptCursor cursor, empty{"", "", ""};
  empty.pLineEnd = empty.pTextEnd = empty.pPos;
  DialogInfo& dialog = bare.dialog;
  EXPECT_EQ(dialog.iAddControls(nullptr, &iID, &bGroup, &bare.context), 1);
  EXPECT_EQ(dialog.iAddControls(&cursor, &iID, &bGroup, &bare.context), 1);
  EXPECT_EQ(dialog.iAddControls(&empty, nullptr, &bGroup, &bare.context), 1);
  EXPECT_EQ(dialog.iAddControls(&empty, &iID, nullptr, &bare.context), 1);
  EXPECT_EQ(dialog.iAddControls(&empty, &iID, &bGroup, nullptr), 1);
  EXPECT_EQ(dialog.GetBaseControl(""), nullptr);
  EXPECT_EQ(dialog.GetBaseControl("unknown"), nullptr);
  CNButton button;
  EXPECT_EQ(button.iReadScript(empty, bare.context), 1);
  EXPECT_EQ(button.Resize(nullptr, 1.0), 1);
  // A line by itself, without the text behind it.
  for (const std::string line : {"LISTVIEW 'v' 1 2 3 4", "MESSAGE_BOX 'm' 1 2 3 4", "TABLE_START",
                                 "START_BEFORE_DRAWING", "START_AFTER_DRAWING"}) {
    ScriptCursor alone{line.data(), line.data() + line.size(), nullptr};
    dialog.iAddControls(&alone, &iID, &bGroup, &bare.context);
  }
  EXPECT_EQ(bare.Count(), 1);
  EXPECT_EQ(log.Lines(), (std::vector<std::string>{
                             "ERROR: DialogInfo::AddEdit -> !pVarInfo -> return PRECONDITIONS_NOT_VALID",
                             "ERROR: DialogInfo::AddRebar -> !pVarInfo -> return PRECONDITIONS_NOT_VALID",
                             "ERROR: DialogInfo::iAddControls -> !szDialog -> return PRECONDITIONS_NOT_VALID",
                             "ERROR: DialogInfo::iAddControls -> !ptrFind -> return PRECONDITIONS_NOT_VALID",
                             "ERROR: DialogInfo::iAddControls -> !iNewIDNum -> return PRECONDITIONS_NOT_VALID",
                             "ERROR: DialogInfo::iAddControls -> !bGroupCheck -> return PRECONDITIONS_NOT_VALID",
                             "ERROR: DialogInfo::iAddControls -> !Dialog -> return PRECONDITIONS_NOT_VALID",
                             "ERROR: DialogInfo::GetBaseControl -> !szControlName || !*szControlName-> return NULL",
                             "ERROR: CNButton -> !szClassLines -> return PRECONDITIONS_NOT_VALID",
                             "ERROR: BaseControl::Resize -> !size",
                             "ERROR: DialogInfo::AddListView -> !end -> return PRECONDITIONS_NOT_VALID",
                             "ERROR: DialogInfo::AddMsgbox -> !end -> return PRECONDITIONS_NOT_VALID",
                             "EXIT: DialogInfo::iSaveTableBuffer-> return FUNCTION_ERROR",
                             "ERROR: DialogInfo::AddExecuteAction -> Missing START_ACTION after START_BEFORE_DRAWING! "
                             "-> return FUNCTION_ERROR",
                             "EXIT_ERROR: DialogInfo::AddExecuteAction -> (!*szDialogCommands || !**szDialogCommands) "
                             "-> return PRECONDITIONS_NOT_VALID",
                         }));
}

}  // namespace
