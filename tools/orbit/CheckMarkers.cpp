#include "CheckPasses.h"

void CheckMarkers(CheckReport& report, ScriptNames& names) {
  const Piece text = report.File().Text();
  for (size_t at = 0; (at = text.find("<%", at)) != Piece::npos;) {
    const size_t end = text.find_first_of("%>\n", at + 2);
    const bool bMarker = end != Piece::npos && text.substr(end, 2) == "%>";
    if (bMarker)
      names.ReadsVariable(text.substr(at + 2, end - at - 2));
    else
      report.Add(Rule::MarkerOpen, text.substr(at));
    at = bMarker ? end + 2 : at + 2;
  }
}
