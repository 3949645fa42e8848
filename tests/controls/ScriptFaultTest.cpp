// What a script's reading shares: the report of its faults, with the exact message and the line, and its variables.
#include "ControlReader.h"
#include "controls/Variables.h"
#include "support/TestFolder.h"

namespace {

// More of them are in tests/scripts/controls-faults.txt.
TEST(ScriptFault, IsReportedOnceWithItsLineAndTheControlKept) {
  const struct {
    const char* szLine;  // the third of the script
    const char* szMessage;
    const char* szWritten;
  } rows[] = {
      {"BUTTON 'b' \"Go\" \"on 1 2 3 4", "nedostaje navodnik!", "BUTTON 'b' \"Go\" 1 2 3 4"},
      {"BUTTON 'b' \"Go\\\" 1 2 3 4", "nedostaje navodnik!", "BUTTON 'b' 1 2 3 4"},
      {"BUTTON 'b' \"Go\" TOOLTIP 'x 1 2 3 4", "nedostaje apostrof!", "BUTTON 'b' \"Go\" 1 2 3 4"},
      {"BUTTON 'b' \"Go\" ID_NEXTT TOOLTIP 'x' 1 1 1 1", "pogresan ID, ili verzija Bafunpraik ne podrzava taj ID",
       "BUTTON 'b' \"Go\" TOOLTIP 'x' 1 1 1 1"},
      {"LISTVIEW 'v' 1 2 3 4", "nedostaje END_LISTVIEW!", "LISTVIEW 'v' 1 2 3 4\nEND_LISTVIEW"},
  };
  for (const auto& row : rows) {
    ControlReader reader(std::string("\n\n") + row.szLine + "\nPAGER 'p' 5 6 7 8");
    EXPECT_EQ(reader.Read().Dump(), std::string(row.szWritten) + "\nPAGER 'p' 5 6 7 8");
    EXPECT_EQ(reader.sink.shown,
              std::vector<std::string>{std::string("syntax error|U datoteci setup.txt, u liniji 3,") + row.szMessage});
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

TEST(ScriptFault, MessageNamesWhatIsKnown) {
  const char szScript[] = "one\ntwo\nthree", szOther[] = "other";
  const struct {
    const char* szFile;
    const char* pPlace;
    int iFault;
    const char* szMessage;
  } rows[] = {
      {"a.txt", szScript + 9, FAULT_COLON, "U datoteci a.txt, u liniji 3,nedostaje dvotocka!"},
      {"a.txt", nullptr, FAULT_COMMA, "U datoteci a.txt,nedostaje zarez!"},
      {"a.txt", szOther, FAULT_ID,  // outside the script
       "U datoteci a.txt,pogresan ID, ili verzija Bafunpraik ne podrzava taj ID"},
      {nullptr, szScript + 9, FAULT_END_OF_SCRIPT, "U  u liniji 3,neocekivan kraj skripte!"},
      {nullptr, nullptr, FAULT_MISSING_WORD_ALSO, "U nedostaje 100%d!"},
      {"a.txt", szScript + 9, 9, "Greska je nedefinirana!"},
      {"a.txt", szScript + 9, -1, "Greska je nedefinirana!"},
  };
  for (const auto& row : rows) {
    RecordingSink sink;
    ScriptReport report(&sink);
    report.Setup(szScript, row.szFile);
    EXPECT_EQ(report.iReport(row.iFault, row.pPlace, "100%d"), 0);
    EXPECT_EQ(sink.shown, std::vector<std::string>{std::string("syntax error|") + row.szMessage});
  }
}

TEST(ScriptFault, DiagnosticLines) {
  TestFolder folder;
  TestLog log(folder);
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

TEST(Variables, KeepTheOrderAndChangeTheFirstRecord) {
  CNVariables variables;
  EXPECT_EQ(variables.pFind("a"), nullptr);
  variables.Set("a", "1");
  CNVariable* pFirst = variables.pFind("a");
  variables.AddTable();
  variables.Set("A", "2");
  variables.Set("a", "3");
  EXPECT_EQ(variables.Size(), 2);
  EXPECT_EQ(variables.pFind("a"), pFirst);
  EXPECT_STREQ(pFirst->csValue.Ptr(), "3");
  EXPECT_STREQ(variables[1]->csName.Ptr(), "A");
  EXPECT_EQ(variables[2], nullptr);
  variables.Set("a", "");
  EXPECT_STREQ(pFirst->csValue.Ptr(), "");
  variables.Set(nullptr, "x");
  variables.Set("b", nullptr);
  EXPECT_EQ(variables.Size(), 2);
  EXPECT_EQ(variables.pFind(nullptr), nullptr);
}

TEST(Variables, RecordsStayWhereTheyAreWhileTheStoreGrows) {
  CNVariables variables;
  variables.Set("v0", "0");
  const CNVariable* pFirst = variables.pFind("v0");
  for (int i = 0; i < 3000; i++) variables.Set(("v" + std::to_string(i)).c_str(), std::to_string(i).c_str());
  EXPECT_EQ(variables.Size(), 3000);
  EXPECT_EQ(variables.pFind("v0"), pFirst);
  for (int i = 0; i < 3000; i++)
    ASSERT_EQ(variables.pFind(("v" + std::to_string(i)).c_str())->csValue.Text(), std::to_string(i));
  EXPECT_EQ(variables.pFind("v3000"), nullptr);
}

}  // namespace
