// Product files: their faults, the script that becomes of them, and the packed file byte by byte.
#include <zlib.h>

#include <functional>

#include "CarriedScript.h"
#include "Check.h"
#include "List.h"
#include "NewProduct.h"
#include "OrbitText.h"
#include "PackProduct.h"
#include "PackedFile.h"
#include "PeImage.h"
#include "ProductFile.h"
#include "ScriptVariables.h"
#include "ToolWizard.h"
#include "archive/ArchiveBytes.h"
#include "archive/CNArchive.h"
#include "orbit/TinyProgram.h"
#include "orbit/ToolFixture.h"
#include "wizard/HeadlessView.h"

namespace {

std::string Text(const Bytes& bytes) { return {bytes.begin(), bytes.end()}; }

const std::string GOOD = "name = 'Reader'\nversion = '2.1'\nfiles = 'files'\n";
const std::string SCRIPT =
    "INIT\n  a = \"1\"\n  program_name = \"x\"\n  > \"y\"\n  // of b\n  b = \"2\"\nEND_INIT\n"
    "DIALOG1 'd' \"<%publisher%>\" 1 2 3 4\nArial\nBEGIN\nEND\nEND_DIALOG1\n";

class ProductTest : public ::testing::Test {
 protected:
  ProductTest() {
    m_folder.MakeFolder("p/files/sub");
    m_folder.Write("p/files/Reader.exe", std::string(3000, 'r'));
    m_folder.Write("p/files/sub/\x9a.txt", "s");
    m_folder.Write("bootstrap.exe", Text(TinyProgram(2)));
    m_folder.Write("setup.exe", Text(TinyProgram(3)));
  }
  std::string Shown(const std::string& name) const { return ToUtf8(m_folder.Path(name).c_str()); }
  // What PackProduct prints and says, with the folder's name left out.
  std::string PackedFrom(const std::string& product) {
    const Printed printed = Capture([&](FILE* pOut, FILE* pErrors) {
      const ProductJob job = {product, {Shown("setup.exe"), Shown("bootstrap.exe")}, "", nullptr, pOut};
      try {
        m_summary = PackProduct(job);
      } catch (const OrbitError& error) {
        fputs(error.what(), pErrors);
      }
      return 0;
    });
    std::string text = printed.out + printed.errors;
    for (const char* szFolder : {"p/", "p\\", "p", ""}) text = Replaced(text, Shown(szFolder), "");
    return text;
  }
  std::string Packed(const std::string& toml) {
    m_folder.Write("p/p.toml", toml);
    return PackedFrom(Shown("p/p.toml"));
  }
  std::string Out() { return m_folder.Read("p/Reader-2.1-install.exe"); }
  // The value that the engine reads from a script.
  std::string EngineValue(const std::string& script, const char* szName) {
    m_folder.Write("s.txt", script);
    HeadlessView view;
    ToolWizard wizard(view);
    EXPECT_EQ(wizard.iLoadScript(Shown("s.txt"), stderr), 0) << script;
    return wizard.szValue(szName);
  }

  TestFolder m_folder;
  ProductSummary m_summary;
};

TEST_F(ProductTest, AllFaultsAreToldWithTheirPlaces) {
  m_folder.Write("p/no.ico", "");
  const struct {
    std::string toml, said;
  } CASES[] = {
      {"naem = 'x'\nversion = 'new'\nfiles = 7\npublisher = \"a\\nb\"\r\nweb = 'two words'\nmail = ''\nscript = "
       "'no.txt'\n"
       "pictures = 'p.toml'\n  output = 'nodir/x.exe'\n",
       "p.toml:1:1: error: unknown key 'naem' (did you mean 'name'?)\nnaem = 'x'\n^\n"
       "p.toml:1:1: error: 'name' is missing: name = \"...\"\nnaem = 'x'\n^\n"
       "p.toml:2:11: error: a version begins with a digit and can be part of a file's name\nversion = 'new'\n"
       "          ^\n"
       "p.toml:3:9: error: 'files' is a text: \"...\"\nfiles = 7\n        ^\n"
       "p.toml:4:13: error: this must be one line\npublisher = \"a\\nb\"\n            ^\n"
       "p.toml:5:7: error: an address has no blanks, quotes, brackets and backslashes\nweb = 'two words'\n      ^\n"
       "p.toml:6:8: error: this must not be empty\nmail = ''\n       ^\n"
       "p.toml:7:10: error: there is no file no.txt\nscript = 'no.txt'\n         ^\n"
       "p.toml:8:12: error: there is no folder p.toml\npictures = 'p.toml'\n           ^\n"
       "p.toml:9:12: error: there is no folder nodir\n  output = 'nodir/x.exe'\n           ^\n"
       "p.toml has errors: nothing was packed"},
      // A column is a character; the line is shown as it was written.
      {GOOD + "publisher = '\xc4\x8c\xd0\xaf'\n[variables]\n'a b' = 1\ngood = true\nbad = 1.5\nworse = \"\\u0001\"\n",
       "p.toml:4:15: error: setup cannot show '\xd0\xaf': code page 1250 has no such character\n"
       "publisher = '\xc4\x8c\xd0\xaf'\n              ^\n"
       "p.toml:6:1: error: a variable's name consists of letters, digits and underscores\n'a b' = 1\n^\n"
       "p.toml:8:7: error: a variable is a text, a whole number, true or false\nbad = 1.5\n      ^\n"
       "p.toml:9:9: error: a variable's text has no control characters\nworse = \"\\u0001\"\n        ^\n"
       "p.toml has errors: nothing was packed"},
      {"name = 'a:b'\nname = 'c'\n",
       "p.toml:2:8: error: Error while parsing key-value pair: cannot redefine existing string 'name'\n"
       "name = 'c'\n       ^\np.toml has errors: nothing was packed"},
      {"name = 'a:b'\nversion='1'\nfiles='files'\noutput = 'x.com'\n\"q\\u001br\" = 2\n",
       "p.toml:1:8: error: a product's name is part of file names: no \\ / : * ? \" < > |, no blank or dot at "
       "its end, no device's such as nul\n"
       "name = 'a:b'\n       ^\n"
       "p.toml:4:10: error: the output is a folder that is there, or a file .exe\noutput = 'x.com'\n         ^\n"
       "p.toml:5:1: error: unknown key 'q r'\n\"q\\u001br\" = 2\n^\n"
       "p.toml has errors: nothing was packed"},
      {GOOD + "icon = 'no.ico'\noutput = 'Setup.exe'\n[variables]\nprogram_flie = 'x'\nwizard_picture = 'no.bmp'\n",
       "p.toml:3:9: warning: the product's files hold no UnInstall.exe: it can be installed, but not removed\n"
       "files = 'files'\n        ^\n"
       "p.toml:4:8: error: the icon is cut short\nicon = 'no.ico'\n       ^\n"
       "p.toml:5:10: warning: a program named setup.exe is started with libraries from its own folder: another name is "
       "safer\noutput = 'Setup.exe'\n         ^\n"
       "p.toml:7:1: warning: the script has no variable 'program_flie': it is added (did you mean 'program_file'?)\n"
       "program_flie = 'x'\n^\n"
       "p.toml:8:1: error: the pictures hold no 'no.bmp'\nwizard_picture = 'no.bmp'\n^\n"
       "p.toml has errors: nothing was packed"},
  };
  for (const auto& row : CASES) {
    EXPECT_EQ(Packed(row.toml), row.said) << row.toml;
    EXPECT_EQ(m_folder.Names("p"), (std::vector<std::string>{"files", "no.ico", "p.toml"}));
  }
}

TEST_F(ProductTest, AScriptIsCheckedFirstAndGetsTheValues) {
  const std::string toml = GOOD + "script = 's.txt'\n[variables]\nb = 'B'\nnew = true\n";
  m_folder.Write("p/s.txt", Replaced(SCRIPT, "BEGIN", "BEGIN\n  BUTON 'b' \"<%new%>\""));
  EXPECT_EQ(Packed(toml),
            "s.txt:11:3: error: unknown control word 'BUTON': the line is ignored (did you mean 'BUTTON'?)\n"
            "  BUTON 'b' \"<%new%>\"\n  ^\np.toml has errors: nothing was packed");
  m_folder.Write("p/s.txt", SCRIPT);
  EXPECT_EQ(Packed(toml), "");
  PackedFile packed(Shown("p/Reader-2.1-install.exe"));
  OsFile bundle;
  EXPECT_TRUE(bundle.bOpen(m_folder.Path("bundle").c_str(), OsOpenMode::Create) && packed.bCopyBundle(bundle));
  EXPECT_EQ(CNArchive(m_folder.Path("bundle").c_str()).ExtractEntry(1, m_folder.Path("").c_str()), ArchiveOk);
  EXPECT_EQ(
      m_folder.Read("wizard.txt"),
      "INIT\n  a = \"1\"\n  program_name = \"Reader\"\n  // of b\n  b = \"B\"\n"
      "new = \"1\"\nproduct_mail = \"\"\nproduct_web = \"\"\nprogram_version = \"2.1\"\npublisher = \"\"\nEND_INIT\n"
      "DIALOG1 'd' \"<%publisher%>\" 1 2 3 4\nArial\nBEGIN\nEND\nEND_DIALOG1\n");
}

TEST_F(ProductTest, ValuesReachTheEngineWhateverTheyHold) {
  const std::string dialog = SCRIPT.substr(SCRIPT.find("DIALOG1"));
  for (const std::string& script : {SCRIPT, dialog, "// c\n" + dialog, "INIT\nEND_INIT\n" + dialog})
    for (const std::string value :
         {"", "\\", "a\\", "\\\\", "\"", "\\\"", "a\"\\n", "\n\t\r x", "// x", "> \"", "\x9a\xc8"})
      EXPECT_EQ(EngineValue(WithVariables(script, {{"b", value}, {"z", "9"}}), "b"), value) << script;
  EXPECT_EQ(EngineValue(WithVariables(SCRIPT, {{"b", "\\"}}), "program_name"), "xy");
}

// With the sample's own values every line is as it was, but for the version in the first title.
TEST_F(ProductTest, TheCarriedScriptFitsEveryProduct) {
  CarriedScriptFacts facts = {"IDB_PLUMO", "http://www.orbit-setup.example/plumo", "plumo@orbit-setup.example", true,
                              true};
  std::string fitted = CarriedScriptFor(facts);
  const std::pair<const char*, const char*> VALUES[] = {{"<%program_name%>", "Plumo"},
                                                        {"<%program_version%>", "<%version%>"},
                                                        {"<%colvane_file%>", "Plumo.exe"},
                                                        {"<%colvane_link%>", "Plumo.lnk"},
                                                        {"<%uninstall_link%>", "UnInstall plumo.lnk"},
                                                        {"<%product_web%>", facts.web.c_str()},
                                                        {"<%product_mail%>", facts.mail.c_str()}};
  for (const auto& [szFrom, szTo] : VALUES) fitted = Replaced(fitted, szFrom, szTo);
  EXPECT_EQ(fitted, CarriedScript());
  for (const bool bAll : {true, false}) {
    facts = {"x.bmp", bAll ? "http://w.example/Plumo" : "", bAll ? "m@w.example" : "", bAll, bAll, bAll ? 14u : 5u};
    const std::string text = CarriedScriptFor(facts);
    const std::string body = FoldName(Replaced(text.substr(text.find("END_INIT")), "http://w.example/Plumo", ""));
    EXPECT_EQ(body.find("plumo"), std::string::npos) << body.substr(body.find("plumo"));
    m_folder.Write("s.txt", text);
    CheckJob job = {{Shown("s.txt")}, {{}, {CARRIED_SCRIPT_NEEDS, std::end(CARRIED_SCRIPT_NEEDS)}}};
    const Printed check = Capture([&](FILE* pOut, FILE*) { return CheckScripts(job, pOut, pOut); });
    EXPECT_TRUE(check.iResult == 0 && check.out.empty()) << check.out;
    EXPECT_EQ(text.find("TEXT_FIELD 'web' \"<%product_web%>\"") != std::string::npos, bAll) << "'&' marks no letter";
    EXPECT_EQ(text.find("ACTION: (http://w.example/Plumo)") != std::string::npos, bAll);
    EXPECT_EQ(text.find("ACTION: (mailto:m@w.example)") != std::string::npos, bAll);
    // A name longer than the sample's takes another line.
    for (const char* szLine : {"TEXT_FIELD 'mail'", "LIST_FIELD 'program'", "LIST_FIELD 'deinstall'", " 180 115 347 45",
                               " 180 120 347 30", " 180 200 347 45", " 10 20 270 45"})
      EXPECT_EQ(text.find(szLine) != std::string::npos, bAll) << szLine;
  }
}

TEST_F(ProductTest, ThePackedFileHasItsPartsInTheirPlaces) {
  m_folder.Write("p/r.ico", Text(TinyIcon()));
  m_folder.MakeFolder("p/pict/deep");
  m_folder.Write("p/pict/wizard.bmp", "bmp");
  m_folder.Write("p/pict/deep/\xe8.bmp", "");
  m_folder.Write("p/files/UNINSTALL.EXE", "u");
  EXPECT_EQ(Packed(GOOD + "publisher = '\xc4\x8c / D.'\nicon = 'r.ico'\npictures = 'pict'\nweb = "
                          "'http://\xc4\x8d.hr'\n[variables]\nquick_launch = false\n"),
            "");
  const std::string out = Out();
  EXPECT_EQ(m_summary.bytesOut, out.size());
  const Bytes bytes(out.begin(), out.end());
  const uint32_t bundle = FindOverlay(bytes), payload = ByteRange(bytes, "").U32(44), place = PeChecksumPlace(bytes);
  EXPECT_EQ(out.substr(28, 16), "rSFX" + std::string(12, '\0'));
  EXPECT_EQ(out.substr(44, 12), Le32(payload) + Le32(static_cast<uint32_t>(out.size()) - payload) + Le32(0));
  uint32_t sum = 0;
  for (size_t i = 0; i < bytes.size(); i++)
    if (i < place || i >= place + 4) sum = (sum + (uint32_t{bytes[i]} << (i % 2 * 8))) % 0xffff;
  EXPECT_EQ(out.substr(place, 4), Le32(sum + static_cast<uint32_t>(out.size())));
  m_folder.Write("bundle", out.substr(bundle, payload - bundle));
  m_folder.MakeFolder("b");
  CNArchive archive(m_folder.Path("bundle").c_str());
  EXPECT_EQ(archive.CheckArchive(), ArchiveOk);
  for (int i = 0; i < 4; i++) EXPECT_EQ(archive.ExtractEntry(i, m_folder.Path("b/").c_str()), ArchiveOk);
  EXPECT_EQ(m_folder.Names("b"), (std::vector<std::string>{"pict", "setup.exe", "wizard.txt"}));
  EXPECT_EQ(m_folder.Names("b/pict"), (std::vector<std::string>{"deep", "wizard.bmp"}));
  EXPECT_TRUE(m_folder.Exists("b/pict/deep/\xe8.bmp"));
  const std::string setup = m_folder.Read("b/setup.exe");
  EXPECT_EQ(setup.substr(0, 64), Text(TinyProgram(3)).substr(0, 64));  // no stamp
  for (const std::string& image : {setup, out.substr(0, bundle)})
    EXPECT_NE(image.find(std::string("R\0e\0a\0d\0e\0r\0 \0S\0e\0t\0u\0p\0", 24)), std::string::npos);
  const std::string script = m_folder.Read("b/wizard.txt");
  for (const auto& [szName, szValue] : {std::pair{"default_path", "\xc8 - D\\Reader"},
                                        {"quick_launch", "0"},
                                        {"program_file", "Reader.exe"},
                                        {"uninstall", ""},
                                        {"program_version", "2.1"}})
    EXPECT_EQ(EngineValue(script, szName), szValue) << szName;
  // The payload is the archive of the files and nothing more.
  TakeOutArchive(Shown("p/Reader-2.1-install.exe"), Shown("taken"));
  std::string whole(100000, '\0');
  uLongf size = static_cast<uLongf>(whole.size());
  EXPECT_EQ(uncompress(reinterpret_cast<Bytef*>(&whole[0]), &size, bytes.data() + payload,
                       static_cast<uLong>(bytes.size() - payload)),
            Z_OK);
  EXPECT_EQ(m_folder.Read("taken"), whole.substr(0, size));
  const Printed listed =
      Capture([&](FILE* pOut, FILE*) { return List(Shown("p/Reader-2.1-install.exe"), pOut, pOut); });
  EXPECT_EQ(listed.iResult, 0);
  size_t at = 0;
  for (const std::string& part : {"bundle: at " + std::to_string(bundle), std::string("wizard.txt"),
                                  std::string("product archive:"), std::string("sub\\\xc5\xa1.txt")})
    EXPECT_NE(at = listed.out.find(part, at), std::string::npos) << part << " in " << listed.out;
  m_folder.Write("p/Reader-2.1-install.exe", "");
  EXPECT_EQ(Packed(m_folder.Read("p/p.toml")), "");
  EXPECT_TRUE(Out() == out) << "the same input gives the same bytes";
}

TEST_F(ProductTest, ProgramsThatCannotBeUsedAndOutputsThatReplaceAnInput) {
  const std::string setup = Text(TinyProgram(3)), bootstrap = Text(TinyProgram(2));
  const struct {
    std::string setup, bootstrap, said;
  } CASES[] = {{setup + "x", bootstrap, "behind its last section"}, {setup, "MZ", "no Windows program"}};
  for (const auto& row : CASES) {
    m_folder.Write("setup.exe", row.setup);
    m_folder.Write("bootstrap.exe", row.bootstrap);
    EXPECT_NE(Packed(GOOD).find(row.said), std::string::npos) << row.said << ": " << Packed(GOOD);
  }
  m_folder.Write("setup.exe", setup);
  m_folder.Write("bootstrap.exe", bootstrap);
  m_folder.MakeFolder("p/pict");
  m_folder.Write("p/pict/a", "");
  for (const char* szOutput : {"../setup.exe", "../bootstrap.exe", "files/new.exe", "files/Reader.exe", "pict/new.exe"})
    EXPECT_NE(Packed(GOOD + "pictures = 'pict'\noutput = '" + szOutput + "'\n").find("the output"), std::string::npos)
        << szOutput;
  EXPECT_EQ(m_folder.Read("setup.exe"), setup);
  EXPECT_EQ(m_folder.Names("p"), (std::vector<std::string>{"files", "p.toml", "pict"}));
}

TEST_F(ProductTest, ANewProductPacksAsItIs) {
  const std::string folder = Shown("\xc8ita\xe8 {}");
  EXPECT_GE(NewProduct(folder).size(), 2u);
  EXPECT_EQ(PackedFrom(folder + "/product.toml").find("error"), std::string::npos);
  EXPECT_EQ(m_summary.output, FromPath(ToPath(folder) / ToPath("\xc4\x8cita\xc4\x8d {}-1.0.0-install.exe")));
  const std::string before = m_folder.Read("\xc8ita\xe8 {}/product.toml");
  EXPECT_THROW(NewProduct(folder), OrbitError);
  EXPECT_EQ(m_folder.Read("\xc8ita\xe8 {}/product.toml"), before);
  for (const std::string name : {"nul", "a?b", "missing/x", "end.", ""})
    EXPECT_THROW(NewProduct(Shown(name)), OrbitError) << name;
  EXPECT_NE(NameFault(std::string(101, 'x')), "");
}

}  // namespace
