// Splits a script into its dialogs and a dialog into header, font, controls and flow text.
#include <algorithm>
#include <string>

#include "CheckScan.h"
#include "controls/DialogInfo.h"
#include "wizard/TextRange.h"

namespace {

const Piece DIALOG = "DIALOG", END_DIALOG = "END_DIALOG";

Piece Digits(Piece text) { return text.substr(0, std::min(text.size(), text.find_first_not_of("0123456789"))); }

// A line that can only be a header: DIALOG and a number. The statement DIALOG "name" has none.
bool bLooksLikeHeader(Piece line) {
  line = piece::TrimFront(line);
  return piece::bStarts(line, DIALOG) && !Digits(line.substr(DIALOG.size())).empty();
}

class BlockScan {
 public:
  BlockScan(CheckReport& report, ScannedScript& script) : m_report(report), m_script(script) {}

  void Run(Piece text) {
    bool bIgnored = false;  // several such lines in a row are one fault
    for (Piece line; !text.empty();) {
      line = text.substr(0, text.find('\n'));
      const size_t at = line.find(DIALOG);
      const bool bEnd = at != Piece::npos && at >= 4 && line.substr(at - 4, 4) == "END_";
      const Piece before = piece::Trim(line.substr(0, at == Piece::npos ? at : at - (bEnd ? 4 : 0)));
      if (!before.empty() && !bIgnored) ReportOutside(before);
      bIgnored = !before.empty() && at == Piece::npos && !bBeginsControl(before);
      if (at == Piece::npos)
        text.remove_prefix(std::min(text.size(), line.size() + 1));
      else if (bEnd)
        text = ReportEndAlone(text.substr(at - 4));
      else
        text = ReadDialog(text.substr(at));
    }
  }

 private:
  void ReportOutside(Piece line) {
    if (bBeginsControl(line))
      m_report.Add(Rule::OutsideControl, line, {piece::Word(line)});
    else
      m_report.Add(Rule::OutsideText, line);
  }

  Piece ReportEndAlone(Piece text) {
    std::string hint;
    if (m_pInnerEnd)
      hint = " (END_DIALOG ended the block in line " + std::to_string(m_report.File().PositionOf(m_pInnerEnd).line) +
             " already)";
    m_report.Add(Rule::EndDialogAlone, text, {}, hint);
    m_pInnerEnd = nullptr;
    text.remove_prefix(END_DIALOG.size());
    return text.substr(Digits(text).size());
  }

  // The text from DIALOG on; returns what stands behind the block.
  Piece ReadDialog(Piece text) {
    Piece rest = text, line;
    const char* pEnd = piece::End(text);
    const char* pEndDialog = nullptr;
    for (bool bFirst = true; !pEndDialog && piece::bNextLine(rest, line); bFirst = false) {
      const size_t at = line.find(END_DIALOG);
      if (at != Piece::npos) pEnd = pEndDialog = line.data() + at;
      if (bFirst || pEndDialog || !bLooksLikeHeader(line)) continue;
      pEnd = line.data();
      break;
    }
    if (!pEndDialog) m_report.Add(Rule::EndDialogMissing, text);
    m_pEngineEnd = pEndDialog ? pEnd + END_DIALOG.size() : pEnd;
    ReadBlock(piece::Between(text.data(), pEnd));
    if (!pEndDialog) return piece::Between(pEnd, piece::End(text));
    const bool bOwnLine = piece::TrimFront(line).data() == pEndDialog;
    m_pInnerEnd = bOwnLine ? nullptr : pEndDialog;
    rest = piece::Between(pEndDialog + END_DIALOG.size(), piece::End(text));
    const Piece number = Digits(text.substr(DIALOG.size())), endNumber = Digits(rest);
    if (!number.empty() && !endNumber.empty() && number != endNumber)
      m_report.Add(Rule::EndDialogNumber, pEndDialog, {endNumber, number});
    // Deliberately: the engine passes over one character behind END_DIALOG, whatever it is.
    return rest.substr(std::min(rest.size(), std::max<size_t>(endNumber.size(), 1)));
  }

  void ReadBlock(Piece block) {
    ScannedDialog& dialog = m_script.dialogs.emplace_back();
    piece::bNextLine(block, dialog.header);
    ReadHeader(dialog);
    ReadFont(block);
    const char* const pBody = BodyStart(block, dialog);
    ReadBody(piece::Between(pBody, piece::End(block)), dialog);
  }

  void ReadHeader(ScannedDialog& dialog) {
    Piece rest = dialog.header.substr(DIALOG.size());
    const auto bSkipped = [](char c) { return !IsLetter(static_cast<unsigned char>(c)) && c != '\'' && c != '"'; };
    while (!rest.empty() && bSkipped(rest.front())) rest.remove_prefix(1);
    rest = ReadKind(rest);
    const size_t quote = rest.find('"');
    const size_t open = rest.substr(0, quote).find('\'');
    if (open != Piece::npos) {
      const size_t close = rest.find('\'', open + 1);
      if (close == Piece::npos)
        m_report.Add(Rule::ApostropheMissing, rest.substr(open));
      else
        dialog.name = rest.substr(open + 1, close - open - 1);
      if (close != Piece::npos) rest.remove_prefix(close + 1);
    }
    ReadCaption(rest);
  }

  Piece ReadKind(Piece rest) {
    const Piece word = piece::Word(rest);
    if (word.empty()) return rest;
    for (const Piece kind : DialogKindWords()) {
      if (!piece::bStarts(word, kind)) continue;
      if (word != kind) m_report.Add(Rule::ReadAs, word, {word, kind});
      return rest.substr(word.size());
    }
    m_report.Add(Rule::UnknownKind, word, {word}, NearMiss(word, DialogKindWords()));
    return rest.substr(word.size());
  }

  // The caption, the four numbers and the flags.
  void ReadCaption(Piece rest) {
    const size_t open = rest.find('"');
    if (open != Piece::npos) {
      const size_t close = rest.find('"', open + 1);
      if (close == Piece::npos) return m_report.Add(Rule::QuoteMissing, rest.substr(open));
      rest.remove_prefix(close + 1);
    }
    const size_t comma = rest.find(',');
    int nNumbers = 0;
    const Piece size = rest.substr(0, comma);
    for (size_t i = 0; i < size.size(); i++)
      if (ScriptText::bIsDigit(size[i]) && (i == 0 || !ScriptText::bIsDigit(size[i - 1]))) nNumbers++;
    if (nNumbers < 4) m_report.Add(Rule::SizeIncomplete, piece::TrimFront(rest));
    if (comma != Piece::npos) ScanFlags(m_report, rest.substr(comma + 1), nullptr);
  }

  // Takes the font line off the block.
  void ReadFont(Piece& block) {
    block = piece::SkipSpace(block);
    if (range::bStartsWord(block.data(), piece::End(block), "BEGIN")) return;
    Piece line;
    if (!piece::bNextLine(block, line) || line.empty() || line.front() != '"') return;
    if (line.find('"', 1) == Piece::npos) m_report.Add(Rule::QuoteMissing, line);
  }

  // The line behind BEGIN; without one, where the controls seem to begin.
  const char* BodyStart(Piece block, const ScannedDialog& dialog) {
    const size_t begin = block.find("BEGIN");
    if (begin == Piece::npos) {
      m_report.Add(Rule::BeginMissing, dialog.header);
      return block.data();
    }
    Piece rest = block, line;
    while (piece::bNextLine(rest, line) && piece::End(line) < block.data() + begin) {
      line = piece::Trim(line);
      if (bBeginsControl(line))
        m_report.Add(Rule::OutsideControl, line, {piece::Word(line)});
      else if (!line.empty() && line.find("TOOLTIP_TIME") == Piece::npos)
        m_report.Add(Rule::TextIgnored, line);
    }
    ReportIgnored(piece::Between(block.data() + begin + 5, piece::End(line)));
    return rest.data();
  }

  void ReportIgnored(Piece text) {
    if (!piece::Trim(text).empty()) m_report.Add(Rule::TextIgnored, piece::Trim(text));
  }

  void ReadBody(Piece text, ScannedDialog& dialog) {
    const char* pEnd = DialogInfo::pFindEnd(text.data(), m_pEngineEnd);
    if (!pEnd) {
      m_report.Add(Rule::EndMissing, piece::End(text));
      m_report.EngineSeesLastAt(text.data());
      const char* const pFlow = FlowStart(text);
      ScanBody(m_report, piece::Between(text.data(), pFlow), dialog);
      dialog.flow = piece::Between(pFlow, piece::End(text));
      return;
    }
    Piece body = piece::Between(text.data(), pEnd);
    const bool bOwnLine = body.find_last_not_of(" \t") == Piece::npos || body[body.find_last_not_of(" \t")] == '\n';
    if (!bOwnLine) {
      // The author means another one, if there is another.
      m_report.Add(Rule::EndWithin, pEnd);
      m_report.GiveUpLine(pEnd);
      pEnd = OwnEnd(text, pEnd);
      body = piece::Between(text.data(), pEnd);
    }
    ScanBody(m_report, body, dialog);
    Piece rest = piece::Between(pEnd + 3, piece::End(text)), line;
    piece::bNextLine(rest, line);
    ReportIgnored(line);
    dialog.flow = rest;
  }

  // The END with a line to itself behind pEnd, or pEnd.
  static const char* OwnEnd(Piece text, const char* pEnd) {
    Piece rest = piece::Between(pEnd, piece::End(text));
    for (Piece line; piece::bNextLine(rest, line);)
      if (line.data() > pEnd && piece::Trim(line) == "END") return piece::Trim(line).data();
    return pEnd;
  }

  // Where the flow text seems to begin when END is missing: behind everything that belongs to controls.
  static const char* FlowStart(Piece text) {
    const char* pFlow = nullptr;
    for (Piece line; piece::bNextLine(text, line);) {
      line = piece::TrimFront(line);
      const Piece word = piece::Word(line);
      if (bBeginsControl(line) || pFindEndWord(word)) pFlow = nullptr;
      const bool bFlowWord = word == "CONTINUE" || word == "IF" || word == "SWITCH" || word == "EXIT";
      if (bFlowWord && !pFlow) pFlow = line.data();
    }
    return pFlow ? pFlow : piece::End(text);
  }

  CheckReport& m_report;
  ScannedScript& m_script;
  const char* m_pEngineEnd = nullptr;  // of the block that is being read: END_DIALOG is part of it
  const char* m_pInnerEnd = nullptr;   // the last END_DIALOG, when it stood within a line
};

}  // namespace

ScannedScript ScanScript(CheckReport& report) {
  ScannedScript script;
  BlockScan(report, script).Run(ScanInit(report, script));
  const bool bUtf16 = piece::bStarts(report.File().Written(), "\xFF\xFE");
  const char* const szHint = bUtf16 ? ": the file is UTF-16, save it as Windows-1250" : "";
  if (script.dialogs.empty()) report.Add(Rule::NoDialog, report.File().Text(), {}, szHint);
  return script;
}
