#include "CarriedScript.h"

#include "CarriedScriptText.h"

namespace {

struct Exchange {
  const char *szFrom, *szTo;
};

// In this order: the sample's name stands in most of the others.
const Exchange EXCHANGES[] = {
    {"<%version%>", "<%program_version%>"},  // the setup program's own is the day on which it was built
    {"\"Plumo.exe\" \"Plumo.lnk\"", "\"<%colvane_file%>\" \"<%colvane_link%>\""},
    {"\"UnInstall plumo.lnk\"", "\"<%uninstall_link%>\""},
    // Not the addresses themselves: in a written caption '&' marks a letter, in what fills a marker it does not.
    {"\"http://www.orbit-setup.example/plumo\"", "\"<%product_web%>\""},
    {"\"plumo@orbit-setup.example\"", "\"<%product_mail%>\""},
    {"Plumo", "<%program_name%>"},
};

// The lines with the product's name that have room for names of so many letters, and with room for one line more.
const struct {
  size_t nLetters;
  Exchange exchange;
} ROOM[] = {{13, {"your computer.\" 180 130 347 30", "your computer.\" 180 115 347 45"}},
            {10, {"following directory.\" 180 135 347 15", "following directory.\" 180 120 347 30"}},
            {10, {"clicking 'Cancel'.\" 180 200 347 30", "clicking 'Cancel'.\" 180 200 347 45"}},
            {5, {"program group.\" 10 20 270 30", "program group.\" 10 20 270 45"}}};

void ReplaceAll(std::string& text, const std::string& from, const std::string& to) {
  for (size_t at = 0; (at = text.find(from, at)) != std::string::npos; at += to.size())
    text.replace(at, from.size(), to);
}

// The line that begins with the words goes, its line feed too.
void DropLine(std::string& text, const std::string& words) {
  const size_t at = text.find("\n  " + words);
  if (at != std::string::npos) text.erase(at, text.find('\n', at + 1) - at);
}

}  // namespace

std::string CarriedScript() { return CARRIED_SCRIPT_TEXT; }

std::string CarriedScriptFor(const CarriedScriptFacts& facts) {
  const std::string whole = CarriedScript();
  const size_t body = whole.find("END_INIT");
  std::string text = whole.substr(body);
  const struct {
    bool bKept;
    const char* szLine;
  } LINES[] = {{!facts.web.empty(), "TEXT_FIELD 'web'"},
               {!facts.mail.empty(), "TEXT_FIELD 'mail'"},
               {facts.bProgram, "LIST_FIELD 'program'"},
               {facts.bUninstaller, "LIST_FIELD 'deinstall'"}};
  for (const auto& row : LINES)
    if (!row.bKept) DropLine(text, row.szLine);
  for (const auto& row : ROOM)
    if (facts.nNameLetters > row.nLetters) ReplaceAll(text, row.exchange.szFrom, row.exchange.szTo);
  for (const Exchange& row : EXCHANGES) ReplaceAll(text, row.szFrom, row.szTo);
  // The product's own texts come last: they may hold the sample's name.
  ReplaceAll(text, "IDB_PLUMO", facts.picture);
  ReplaceAll(text, "plumo@orbit-setup.example", facts.mail);
  ReplaceAll(text, "http://www.orbit-setup.example/plumo", facts.web);
  return whole.substr(0, body) + text;
}
