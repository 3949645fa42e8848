// What a maker does by mistake: outputs that would take an input's place, names that Windows takes for the same, words
// of other languages in a script.
#ifndef _WIN32
#include <sys/stat.h>
#endif

#include "Check.h"
#include "Dump.h"
#include "List.h"
#include "OrbitText.h"
#include "OutputFile.h"
#include "PackProduct.h"
#include "PackedFile.h"
#include "archive/ArchiveBytes.h"
#include "orbit/TinyProgram.h"
#include "support/TestFolder.h"

namespace {

const std::string PAGE = "DIALOG1 'a' \"\" 0 0 10 10\nBEGIN\n";

class PackingTest : public ::testing::Test {
 protected:
  PackingTest() {
    m_folder.MakeFolder("p/files");
    m_folder.Write("p/files/Reader.exe", std::string(3000, 'r'));
    for (const char* szName : {"setup.exe", "bootstrap.exe"}) {
      const Bytes program = TinyProgram(3);
      m_folder.Write(szName, std::string(program.begin(), program.end()));
    }
  }
  std::string Shown(const std::string& name) const { return ToUtf8(m_folder.Path(name).c_str()); }
  // What the work refuses or prints, with the folder's name left out.
  template <class Work>
  std::string Said(Work work) {
    FILE* const pOut = OsOpenStream(m_folder.Path("said").c_str(), "wb+");
    std::string said;
    try {
      work(pOut);
    } catch (const OrbitError& error) {
      said = error.what();
    }
    fclose(pOut);
    said = m_folder.Read("said") + said;
    const std::string root = Shown("");
    for (size_t at; (at = said.find(root)) != std::string::npos;) said.erase(at, root.size());
    return said;
  }
  std::string Packed(const std::string& toml) {
    m_folder.Write("p/p.toml", toml);
    return Said([&](FILE* pOut) {
      PackProduct({Shown("p/p.toml"), {Shown("setup.exe"), Shown("bootstrap.exe")}, "", nullptr, pOut});
    });
  }
  std::string Checked(const std::string& script) {
    m_folder.Write("s.txt", script);
    return Said([&](FILE* pOut) { CheckScripts({{Shown("s.txt")}, {}}, pOut, pOut); });
  }

  TestFolder m_folder;
};

TEST_F(PackingTest, OutputsReplaceFilesAloneAndNotWhatTheyAreMadeOf) {
  EXPECT_EQ(Packed("name = 'Reader'\nversion = '2'\nfiles = 'files'\noutput = 'out.exe'\n").find("error"),
            std::string::npos);
  const std::string packed = m_folder.Read("p/out.exe");
  EXPECT_EQ(Said([&](FILE*) { TakeOutArchive(Shown("p/out.exe"), Shown("p/out.exe")); }),
            "the output would overwrite p/out.exe");
  EXPECT_TRUE(m_folder.Read("p/out.exe") == packed);
  const std::string script = "// a comment\n" + PAGE + "END\nEND_DIALOG1\n";
  m_folder.Write("s.txt", script);
  EXPECT_EQ(Said([&](FILE* pOut) {
              DumpScript({Shown("s.txt"), Shown("s.txt"), false}, pOut, pOut);
            }),
            "the output would overwrite s.txt");
  EXPECT_EQ(m_folder.Read("s.txt"), script);
  EXPECT_EQ(Said([&](FILE*) { OutputFile(Shown("no/such/file")); }),
            "cannot create a file beside no/such/file: there is no folder no/such");
#ifndef _WIN32
  EXPECT_EQ(mkfifo(m_folder.Path("pipe").c_str(), 0600), 0);
  EXPECT_EQ(Said([&](FILE*) { OutputFile(Shown("pipe")); }), "pipe is a device or the like, not a file");
  std::filesystem::create_symlink("s.txt", ToPath(Shown("link")));
  OutputFile output(Shown("link"));
  output.Write("new", 3);
  output.Commit("");
  EXPECT_EQ(m_folder.Read("s.txt"), "new") << "a link stays one";
  EXPECT_EQ(Said([&](FILE*) { OutputFile("a\\b.exe"); }),
            "no file can be written as a\\b.exe: on this system folders are separated by '/'");
#endif
}

// In the bundle two names in other cases would be one file on the disk, and the plain picture the last that is written.
TEST_F(PackingTest, PicturesAreFoundAsWindowsFindsThem) {
  m_folder.MakeFolder("p/pict");
  m_folder.Write("p/pict/Wizard.BMP", "mine");
  m_folder.Write("p/pict/Side.bmp", "mine");
  const std::string toml = "name = 'Reader'\nversion = '2'\nfiles = 'files'\npictures = 'pict'\noutput = 'out.exe'\n";
  for (const std::string variables : {"", "[variables]\nwizard_picture = 'side.BMP'\n"}) {
    EXPECT_EQ(Packed(toml + variables).find("error"), std::string::npos) << Packed(toml + variables);
    const std::string listed = Said([&](FILE* pOut) { EXPECT_EQ(List(Shown("p/out.exe"), pOut, pOut), 0); });
    EXPECT_NE(listed.find("pict\\Wizard.BMP"), std::string::npos) << listed;
    EXPECT_EQ(listed.find("pict\\wizard.bmp"), std::string::npos) << listed;
  }
}

// Either right on every page and in every path, or refused where it is written.
TEST_F(PackingTest, NamesMayHoldWhatSetupAndWindowsLeaveAlone) {
  const std::string files = "files = 'files'\noutput = 'out.exe'\n", rest = "version = '2'\n" + files;
  EXPECT_EQ(Packed("name = \"100% Tom & Jerry's (b) 5 % c%%\"\npublisher = 'R&D \\ \"x\" 1%'\n" + rest).find("error"),
            std::string::npos);
  const std::string named = "name = 'Reader'\n", longest(100, '1'), longer = longest + "1";
  EXPECT_EQ(Packed(named + "version = '" + longest + "'\npublisher = '" + longest + "'\n" + files).find("error"),
            std::string::npos);
  const struct {
    std::string toml, said;
  } CASES[] = {
      {"name = '5% %TEMP% R'\n" + rest, "p.toml:1:8: error: Windows would take '%TEMP%' for a variable of its own: "},
      {"name = '<%x%>'\n" + rest, "p.toml:1:8: error: a product's name is part of file names: no \\ / : * ? "},
      {named + "publisher = 'a %b% c'\n" + rest, "p.toml:2:13: error: Windows would take '%b%' for a variable"},
      {named + "publisher = 'a <%b'\n" + rest, "p.toml:2:13: error: setup would take '<%' for the beginning of a "},
      {named + "publisher = '" + longer + "'\n" + rest, "p.toml:2:13: error: a publisher's name has at most 100 char"},
      {named + "version = '" + longer + "'\n" + files, "p.toml:2:11: error: a version has at most 100 characters"},
  };
  for (const auto& row : CASES) EXPECT_NE(Packed(row.toml).find(row.said), std::string::npos) << Packed(row.toml);
}

TEST_F(PackingTest, AListingTellsWhichArchiveIsGood) {
  Packed("name = 'Reader'\nversion = '2'\nfiles = 'files'\noutput = 'out.exe'\n");
  std::string packed = m_folder.Read("p/out.exe");
  const PackedFile parts(Shown("p/out.exe"));
  packed[parts.Stamp().payloadOffset - 12] ^= 1;  // within the bundle's terminator and check value
  m_folder.Write("bad", packed);
  const std::string listed = Said([&](FILE* pOut) { EXPECT_GT(List(Shown("bad"), pOut, pOut), 0); });
  EXPECT_NE(listed.find("everything verified", listed.find("NOT GOOD")), std::string::npos) << listed;
}

TEST_F(PackingTest, LettersInThePlaceOfAKey) {
  for (const char* szLetter : {"\xc4\x8d", "\xc3\xa0", "\xd0\xb0"})
    EXPECT_NE(Packed(std::string("name = 'x' ") + szLetter + " = 1\n").find("p.toml:1:12: error: "), std::string::npos);
}

TEST_F(PackingTest, CheckKnowsWhatIsRight) {
  const std::string right =
      "DIALOG1 'a' \"\" 0 0 10 10,TOOLTIP_TIME 500,CENTER\nBEGIN\n"
      " TREE_VIEW 't' 1 2 3 4\n  ITEM '0,0' \"A\" ACTION: (EXIT)\n  ITEM '1' \"B\" ACTION: (x = size)\n END_TREE_VIEW\n"
      " TOOLBAR 'b' 0 0 0 0\n  COMBO 'size' \"10\" \"12\" 60\n END_TOOLBAR\n"
      "END\nIF (size == x) THEN EXIT\nEND_DIALOG1\n";
  EXPECT_EQ(Checked(right), "");
}

TEST_F(PackingTest, CheckTellsWhatWasMeant) {
  const struct {
    std::string script, said;
  } CASES[] = {
      {PAGE + "END\nIF (win_ver = \"a\") THEN EXIT\nIF (win_ver == \"a\" AND _TRUE) THEN EXIT\nEND_DIALOG1\n",
       "s.txt:4:13: error: the condition cannot be read from here on (did you mean '=='?)\n"
       "s.txt:5:20: error: the condition cannot be read from here on (did you mean '&&'?)\n"},
      {PAGE + "END\nx = 'a'\nIF (TRUE) THEN EXIT\nEND_DIALOG1\n",
       "s.txt:4:5: error: the variable ''a'' is set nowhere (a literal stands in double quotes)\n"
       "s.txt:5:5: error: the variable 'TRUE' is set nowhere (did you mean '_TRUE'?)\n"},
      // The ending that all of them have makes no name like another.
      {PAGE + "BUTTON 'more' \"M\" 1 2 3 4 ACTION: ()\nEND\nEND_DIALOG1\n",
       "s.txt:3:9: error: the event runs 'more_OnClick', which is no command\n"},
      // What is around an action without its end, and what is in it, is read all the same.
      {PAGE + "FRAME 'f' 1 2 3 4\nSTART_AFTER_DRAWING\nSTART_ACTION\nUnzipp ()\nEND_FRAME\nEND\nEND_DIALOG1\n",
       "s.txt:4:1: error: START_AFTER_DRAWING without FINISH_ACTION\n"
       "s.txt:6:1: error: unknown command 'Unzipp' (did you mean 'Unzip'?)\n"},
      {std::string("\xFF\xFE") + "D\0I\0A\0",
       "s.txt:1:1: warning: this line stands outside of every dialog and is ignored\n"
       "s.txt:1:1: error: the script has no dialog: the file is UTF-16, save it as Windows-1250\n"},
  };
  for (const auto& row : CASES) {
    std::string heads;  // without the source lines and carets
    const std::string said = Checked(row.script);
    for (size_t at = 0, end; at < said.size(); at = end + 1) {
      end = std::min(said.find('\n', at), said.size());
      if (said.compare(at, 6, "s.txt:") == 0) heads += said.substr(at, end - at) + "\n";
    }
    EXPECT_EQ(heads, row.said);
  }
}

}  // namespace
