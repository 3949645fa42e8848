// What a check reports. The faults themselves, with their right neighbours, stand in check/*.txt:
//   === the rules' names, where the lines stand in their script: whole, init, header, body, action or flow
//   the faulty lines; @dialog stands for a whole dialog, @begin for one up to its BEGIN
//   --- LINE:COLUMN: error: text, for each fault in order
//   +++
//   the lines set right, unless another row or one of the good scripts has them
#include "Check.h"

#include <filesystem>
#include <fstream>
#include <map>
#include <regex>
#include <sstream>

#include "CheckRules.h"
#include "CheckWords.h"
#include "OrbitText.h"
#include "orbit/ToolFixture.h"

namespace {

const std::string HEADER = "DIALOG1 'd' \"c\" 1 2 3 4\n", FONT = "\"Arial\" 15 500\n", TAIL = "END_DIALOG1\n";
const std::string BEGIN = HEADER + FONT + "BEGIN\n", DIALOG = BEGIN + "END\n" + TAIL;

// A script of one dialog (of two for a flow text) with the lines in the place named.
std::string Script(const std::string& place, const std::string& lines) {
  const std::string next = "DIALOG2 'e' \"c\" 1 2 3 4\nArial\nBEGIN\nEND\nEND_DIALOG2\n";
  const std::string action = " START_BEFORE_DRAWING\n  START_ACTION\n" + lines + "  FINISH_ACTION\n";
  const std::map<std::string, std::string> scripts = {{"whole", lines},
                                                      {"init", "INIT\n" + lines + "END_INIT\n" + DIALOG},
                                                      {"header", lines + FONT + "BEGIN\nEND\n" + TAIL},
                                                      {"body", BEGIN + lines + "END\n" + TAIL},
                                                      {"action", BEGIN + action + "END\n" + TAIL},
                                                      {"flow", BEGIN + "END\n" + lines + TAIL + next}};
  return scripts.at(place);
}

struct Row {
  std::string title, place, lines, faults, clean;
};

std::vector<Row> Rows(const char* szFile) {
  const std::map<std::string, std::string> macros = {{"@dialog", DIALOG}, {"@begin", BEGIN}};
  std::vector<Row> rows;
  std::ifstream file(SourcePath(std::string("tests/orbit/check/") + szFile), std::ios::binary);
  EXPECT_TRUE(file) << szFile;
  std::string* pPart = nullptr;
  for (std::string line; std::getline(file, line);) {
    if (line.rfind("=== ", 0) == 0) {
      rows.push_back({line.substr(4), line.substr(line.rfind(' ') + 1), "", "", ""});
      pPart = &rows.back().lines;
    } else if (line.rfind("--- ", 0) == 0) {
      rows.back().faults += (rows.back().faults.empty() ? "" : "\n") + line.substr(4);
    } else if (line == "+++") {
      pPart = &rows.back().clean;
    } else {
      *pPart += macros.count(line) ? macros.at(line) : line + "\n";
    }
  }
  return rows;
}

class CheckTest : public ::testing::TestWithParam<const char*> {
 protected:
  // What a check prints, the folder's name left out.
  std::string Output(const std::string& script, const CheckOptions& options = {}) {
    m_folder.Write("s.txt", script);
    return Printed({{m_folder.Path("s.txt")}, options});
  }
  std::string Printed(const CheckJob& job) {
    const auto printed = Capture([&](FILE* pOut, FILE* pErrors) { return CheckScripts(job, pOut, pErrors); });
    m_iResult = printed.iResult;
    return Replaced(printed.errors + printed.out, m_folder.Path(""), "");
  }
  // The faults without their source lines: "LINE:COLUMN: error: text" each. The carets are held against the columns.
  std::string Faults(const std::string& script, const CheckOptions& options = {}) {
    const std::string text = Output(script, options), name = "s.txt:";
    std::istringstream lines(text);
    std::string faults;
    for (std::string fault, source, caret; std::getline(lines, fault);) {
      EXPECT_TRUE(std::getline(lines, source) && std::getline(lines, caret)) << text;
      faults += (faults.empty() ? "" : "\n") + fault.substr(name.size());
      const int iColumn = atoi(fault.c_str() + fault.find(':', name.size()) + 1);
      EXPECT_EQ(caret, std::string(static_cast<size_t>(iColumn - 1), ' ') + "^") << fault;
    }
    EXPECT_EQ(m_iResult, text.find(": error: ") != std::string::npos) << text;
    return faults;
  }

  TestFolder m_folder;
  int m_iResult = -1;
};

TEST_P(CheckTest, FindsEachFaultAtItsPlaceAndNoneInItsRightNeighbour) {
  for (const Row& row : Rows(GetParam())) {
    EXPECT_EQ(Faults(Script(row.place, row.lines)), row.faults) << row.title << "\n" << row.lines;
    EXPECT_EQ(row.clean.empty() ? "" : Faults(Script(row.place, row.clean)), "") << row.title << "\n" << row.clean;
  }
}

const char* const FILES[] = {"blocks.txt", "lines.txt", "dialogs.txt", "flow.txt", "names.txt"};
INSTANTIATE_TEST_SUITE_P(Faults, CheckTest, ::testing::ValuesIn(FILES), [](const auto& info) {
  return std::string(info.param).substr(0, std::string(info.param).find('.'));
});

// Each weight and each wording of the table is met by a row.
TEST(CheckRulesTest, EveryRuleHasItsRow) {
  std::string faults;
  for (const char* szFile : FILES)
    for (const Row& row : Rows(szFile)) faults += row.faults + "\n";
  for (int i = 0; i < static_cast<int>(Rule::Count); i++) {
    const RuleRow& row = RowOf(static_cast<Rule>(i));
    const std::string words = std::regex_replace(row.szText, std::regex(R"([.()\[\]\\])"), R"(\$&)");
    const std::string pattern = (row.bError ? ": error: " : ": warning: ") + Replaced(words, "{}", ".*");
    EXPECT_TRUE(std::regex_search(faults, std::regex(pattern))) << pattern;
  }
}

// The words of a check are held against the engine's own tables, as its units write them.
using Match = std::smatch;
template <class Take>
int iForEach(const std::string& text, const char* szPattern, Take take) {
  const std::regex pattern(szPattern);
  const std::sregex_iterator first(text.begin(), text.end(), pattern), last;
  std::for_each(first, last, take);
  return static_cast<int>(std::distance(first, last));
}

TEST(CheckWordsTest, EveryKindOfTheEngineIsKnown) {
  const std::string table = TestFolder::ReadFile(SourcePath("src/controls/ControlTable.cpp"));
  const auto hold = [](const Match& row) {
    const std::string word = row[1], makes = row[2], endWord = row[3];
    const KindRow* const pKind = pFindKind(word);
    EXPECT_TRUE(bBeginsControl(word + " 'x'")) << word;
    EXPECT_EQ(pKind != nullptr, !makes.empty()) << word;
    EXPECT_TRUE(!pKind || endWord.empty() || pKind->endWord == endWord) << word;
  };
  const char* const szRow = R"re(\{"([A-Z_]+)",\s*\d+,\s*ControlRow::\w+(,[^}]*?)?(?:"(END_\w+)")?\})re";
  EXPECT_EQ(iForEach(table, szRow, hold), static_cast<int>(LineWords().size()));
}

// Where a unit names its kind, the flags must be that kind's; else any kind's.
TEST(CheckWordsTest, EveryFlagOfTheEngineIsKnown) {
  int iFlags = 0;
  for (const auto& entry : std::filesystem::directory_iterator(ToPath(SourcePath("src/controls")))) {
    if (entry.path().extension() != ".cpp" || entry.path().stem() == "DialogHeader") continue;
    const std::string unit = TestFolder::ReadFile(FromPath(entry.path()));
    const KindRow* pKind = nullptr;
    const auto name = [&](const Match& kind) { pKind = pFindKind(Piece(&*kind[1].first, kind[1].length())); };
    const auto hold = [&](const Match& flag) {
      const std::string word = flag[1].matched ? flag[1] : flag[2];
      EXPECT_TRUE(word == "MARGIN_" || (pKind ? bKnowsFlag(pKind, word) : bIsFlag(word))) << entry.path() << word;
    };
    if (iForEach(unit, R"re(ControlKind::\w+,\s*"([A-Z_]+)")re", name) > 1) pKind = nullptr;
    iFlags +=
        iForEach(unit, R"re(\{"(\w+)", (?:STYLE_|FontVariant::|ControlAlign::)|(?:Flag|FlagColor)\("(\w+)"\))re", hold);
  }
  EXPECT_GT(iFlags, 60);
}

TEST_F(CheckTest, TheGoodScriptsAreClean) {
  CheckJob job;
  for (const char* szName : GOOD_SCRIPTS) job.scripts.push_back(SourcePath(szName));
  EXPECT_EQ(Printed(job), "");
  EXPECT_EQ(m_iResult, 0);
}

// Columns count characters of the line as written: a tab is one, a letter beyond ASCII too, a carriage return none.
TEST_F(CheckTest, ShowsTheLineAsWrittenAndACaretBelowThePlace) {
  const std::string script = "// comment\r\n" + DIALOG +
                             "\tDIALOG2\t'\x9e'\t\"\xe8\"\t1 2 3 4, CENTRE\r\nArial\r\nBEGIN\r\n" +
                             "\tEDITFIELD\t'x'\r\nEND\r\n\tDIALOG\t\"dd\"\r\nEND_DIALOG2";
  EXPECT_EQ(Output(script),
            "s.txt:7:27: error: unknown flag 'CENTRE' (did you mean 'CENTER'?)\n"
            "\tDIALOG2\t'\xc5\xbe'\t\"\xc4\x8d\"\t1 2 3 4, CENTRE\n"
            "\t       \t   \t   \t         ^\n"
            "s.txt:10:2: error: unknown control word 'EDITFIELD': the line is ignored (did you mean 'EDIT_FIELD'?)\n"
            "\tEDITFIELD\t'x'\n"
            "\t^\n"
            "s.txt:12:10: error: no dialog is named 'dd'\n"
            "\tDIALOG\t\"dd\"\n"
            "\t      \t ^\n");
}

TEST_F(CheckTest, SeesTheMarkOfUtf8WithoutAnyLetter) {
  EXPECT_EQ(Faults("\xef\xbb\xbf" + DIALOG),
            "1:1: error: the file is UTF-8: the setup program reads Windows-1250 and shows other letters here");
}

TEST_F(CheckTest, ChecksEveryScriptAndTellsOfTheOneThatCannotBeRead) {
  m_folder.Write("a.txt", DIALOG + "tail\n");
  m_folder.Write("DIALOG.txt", DIALOG);
  EXPECT_EQ(Printed({{m_folder.Path("a.txt"), m_folder.Path("DIALOG.txt")}, {}}),
            "a.txt:6:1: warning: this line stands outside of every dialog and is ignored\ntail\n^\n");
  EXPECT_EQ(m_iResult, 0);
  EXPECT_EQ(Printed({{m_folder.Path("none.txt"), m_folder.Path("DIALOG.txt")}, {}}), "orbit: cannot read none.txt\n");
  EXPECT_EQ(m_iResult, 1);
}

TEST_F(CheckTest, KnowsWhatAnAuthorsOwnProgramAdds) {
  const std::string script = Script("flow", "OwnCommand (a)\nx = own_variable\n");
  EXPECT_EQ(Faults(script, {{"OwnCommand"}, {"own_variable"}}), "");
  EXPECT_EQ(Faults(script, {{"owncommand"}, {}}),
            "5:1: error: unknown command 'OwnCommand'\n6:5: error: the variable 'own_variable' is set nowhere");
}

// Far from what the time would be if each fault looked at the whole script.
TEST_F(CheckTest, TakesALongScriptWithAFaultInEachLine) {
  std::string lines;
  const int iLines = 20000;
  for (int i = 0; i < iLines; i++) lines += " EDIT_FIELD 'e" + std::to_string(i) + " 1 2 3 4, <%x%>\n";
  const uint32_t ticks = OsTickCount();
  const std::string text = Output(Script("body", lines));
  EXPECT_LT(OsTickCount() - ticks, 120000u);
  EXPECT_EQ(std::count(text.begin(), text.end(), '\n'), 2 * 3 * iLines);
}

// Whatever one character does when it is gone, the scan sees what the engine sees.
TEST_F(CheckTest, SeesWhatTheEngineReports) {
  const std::string script = TestFolder::ReadFile(SourcePath("src/installer/scripts/exit.txt")) +
                             Script("body",
                                    " MESSAGE_BOX 'm' \"M\"\n  > x\n END_MESSAGE_BOX\n GROUP\n END_GROUP\n"
                                    " LIST_FIELD 'l' \"x\" \"y\" 1 2 3 4, HIDE\n"
                                    " TEXT_FIELD 't' \"T\" TOOLTIP 'x' 1 2 3 4, LINK ACTION: (DIALOG \"d\")\n") +
                             Script("action", "Next ()\n");
  for (size_t at = 0; at < script.size(); at++) {
    if (strchr("'\"(),>\n_", script[at]) == nullptr) continue;
    std::string changed = script;
    changed.erase(at, 1);
    EXPECT_EQ(Output(changed).find("the engine reports"), std::string::npos)
        << changed.substr(at > 40 ? at - 40 : 0, 80);
  }
}

}  // namespace
