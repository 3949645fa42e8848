#include "CheckWords.h"

#include <algorithm>
#include <iterator>
#include <unordered_map>
#include <unordered_set>

namespace {

const Piece CLICK = "_OnClick";
const Piece FOCUS_EVENTS = "_OnSetFocus _OnKillFocus";
const Piece COMBO_EVENTS = "_OnSelChange _OnEditUpdate _OnEditChange _OnDropUp _OnDropDown";
const Piece LIST_EVENTS = "_OnDoubleClick _OnSelChange";
const Piece VIEW_EVENTS = "_OnDoubleClick _OnSelChange _OnEditChange";
const Piece MOUSE_EVENTS = "_OnMouseIn _OnMouseOut _OnMouseUp _OnMouseDown";
const Piece LIST_FLAGS =
    "SORT MULTIPLE_SEL SCROLL NO_VSCROLL NO_HSCROLL NO_SCROLL KEYINPUT OWNER_DRAWN LEFT RIGHT RGB NO_VAR_SAVE "
    "NO_REORDER_LIST DRAG R_DRAG GLOBAL_DRAG GLOBAL_R_DRAG";
const Piece BOX_FLAGS =
    "MB_ABORTRETRYIGNORE MB_YESNOCANCEL MB_YESNO MB_RETRYCANCEL MB_OKCANCEL MB_OK MB_CANCELTRYCONTINUE MB_ICONERROR "
    "MB_ICONQUESTION MB_ICONEXCLAMATION MB_ICONINFORMATION";
const Piece RICH_FLAGS = "READ_ONLY V_SCROLL H_SCROLL CENTER AUTOVSCROLL AUTOHSCROLL MULTILINE FLAT GRAY REMEMBER";
const Piece VIEW_FLAGS =
    "REPORT LIST SINGLE_SEL SHOW_ALWAYS FULL_ROW_SEL GRID_LINES FLAT_SB CHECKBOX NOCOLUMNHEADER SORT NO_VAR_SAVE EDIT "
    "RE_EDIT COMBO PROGRESS";
const Piece TREE_FLAGS = "CHECKBOX NO_VAR_SAVE NO_REORDER_LIST DRAG R_DRAG GLOBAL_DRAG GLOBAL_R_DRAG";
const Piece SETTER_EVENTS = "_OnSelChange";

const unsigned FIELD = TAKES_FOCUS | HOLDS_VALUE | SIZED;
const unsigned SETTER = TAKES_FOCUS | HOLDS_VALUE | OWN_WORDS;
const unsigned DATA = NO_WINDOW | OWN_WORDS;

const KindRow g_kinds[] = {
    {"BUTTON", TAKES_FOCUS | MNEMONIC | SIZED | CLICKED, "DEFAULT MULTILINE CENTER OWNER_DRAWN GRADIENT TOP BOTTOM",
     CLICK, ""},
    {"TEXT_FIELD", MNEMONIC | SIZED, "ALEFT ARIGHT ACENTER FRAME LINK", CLICK, ""},
    {"PROGRESS_BAR", SIZED, "VERTICAL SMOOTH", "", ""},
    {"CHECK_BOX", FIELD | MNEMONIC, "MULTILINE RADIO_BUTTON", CLICK, ""},
    {"EDIT_FIELD", FIELD, "READ_ONLY V_SCROLL AUTOVSCROLL MULTILINE GRAY", FOCUS_EVENTS, ""},
    {"RICH_EDIT", TAKES_FOCUS | KEEPS_VALUE | SIZED, RICH_FLAGS, FOCUS_EVENTS, ""},
    {"LIST_FIELD", FIELD | STRINGS, LIST_FLAGS, LIST_EVENTS, ""},
    {"SIMULATED_LIST_FIELD", FIELD | STRINGS, LIST_FLAGS, LIST_EVENTS, ""},
    {"COMBO_FIELD", FIELD, "EDIT SORT OWNER_DRAWN IMAGE_COMBO NO_VAR_SAVE NO_REORDER_LIST", COMBO_EVENTS, "END_COMBO"},
    {"MESSAGE_BOX", NO_WINDOW, BOX_FLAGS, "", "END_MESSAGE_BOX"},
    {"MENU_BAR", DATA | NAMES_COMMAND, "OWNER_DRAWN RGB", "", "END_MENUBAR"},
    {"RIGHT_CLICK_MENU", DATA | NAMES_COMMAND | NAMES_CONTROL, "OWNER_DRAWN RGB", "", "END_RIGHT_CLICK_MENU"},
    {"GROUP_BOX", MNEMONIC | CONTAINER, "", "", "END_GROUP_BOX"},
    {"FRAME", CONTAINER, "BORDER", "", "END_FRAME"},
    {"TRACKBAR", SETTER, "VERTICAL TICK NO_TICK NO_VAR_SAVE", SETTER_EVENTS, ""},
    {"LISTVIEW", FIELD, VIEW_FLAGS, VIEW_EVENTS, "END_LISTVIEW"},
    {"REBAR", OWN_WORDS | NAMES_COMMAND, "", "", "END_REBAR"},
    {"UP_DOWN", SETTER, "ALIGNRIGHT ALIGNLEFT HORIZONTAL NO_VAR_SAVE", SETTER_EVENTS, ""},
    {"ACCELERATOR", DATA | ANY_FLAGS | RUNS_ACTION, "", "", ""},
    {"GLOBAL_ACCELERATOR", DATA | ANY_FLAGS | RUNS_ACTION, "", "", ""},
    {"CURSOR", DATA | NAMES_CONTROL, "", "", ""},
    {"SPLITTER", OWN_WORDS, "HORIZONTAL BORDER", "", ""},
    {"WAVE", DATA, "PLAY CONTINUOUS", "", ""},
    {"TREE_VIEW", FIELD, TREE_FLAGS, LIST_EVENTS, "END_TREE_VIEW"},
    {"IMAGE", OWN_WORDS, "CUSTOM STRETCH TRANSPARENT", MOUSE_EVENTS, ""},
    {"IPADDRESS", SETTER, "NO_VAR_SAVE", SETTER_EVENTS, ""},
    {"MONTHCALENDAR", SETTER, "MULTISELECT WEEKNUMBERS NO_VAR_SAVE", SETTER_EVENTS, ""},
    {"ANIMATION", OWN_WORDS, "TRANSPARENT BORDER PLAY CONTINUOUS", "", ""},
    {"DATE_PICKER", SETTER, "TIME NO_VAR_SAVE", SETTER_EVENTS, ""},
    {"HOTKEY", SETTER, "NONE CTRL SHIFT ALT NO_VAR_SAVE", SETTER_EVENTS, ""},
    {"HEADER", OWN_WORDS | STRINGS, "BUTTONS", CLICK, ""},
    {"PAGER", OWN_WORDS | NAMES_CONTROL, "VERTICAL", "", ""},
    {"STATUS_BAR", OWN_WORDS | STRINGS, "", "", ""},
    {"PROPERTY_SHEET", CONTAINER | HOLDS_VALUE | OWN_WORDS, "MODAL MULTILINE NO_VAR_SAVE", SETTER_EVENTS,
     "END_PROPERTY_SHEET"},
    {"TAB_CONTROL", CONTAINER | HOLDS_VALUE | OWN_WORDS, "MULTILINE NO_VAR_SAVE", SETTER_EVENTS, "END_TAB_CONTROL"},
    {"TOOLBAR", DATA | NAMES_COMMAND, "Standard LARGE LABEL", "", "END_TOOLBAR"},
};

const KindRow g_item = {"ITEM", DATA | STRINGS | RUNS_ACTION,
                        "CHECKED RGB VAR LEFT RIGHT CENTER EDIT RE_EDIT COMBO PROGRESS COLLAPSED Standard LARGE LABEL "
                        "minWidth BREAK",
                        "", ""};
const KindRow g_parts[] = {
    {"TAB", CONTAINER | OWN_WORDS, "", "", "END_TAB"},
    {"SHEET", CONTAINER | OWN_WORDS, "", "", "END_SHEET"},
};

const Piece DIRECTIVES[] = {"GROUP", "END_GROUP", "TABLE_START", "START_BEFORE_DRAWING", "START_AFTER_DRAWING"};

const Piece SHARED_FLAGS =
    "HIDE DISABLE FOCUS BACKGROUND TEXT_COLOR ITALIC UNDERLINE BIGBOLD BOLD ALIGN_RIGHT ALIGN_LEFT ALIGN_TOP "
    "ALIGN_BOTTOM MARGIN MARGIN_LEFT MARGIN_RIGHT MARGIN_TOP MARGIN_BOTTOM NO_LOGPIXELS FIXED RIGHTRESIZABLE "
    "BOTTOMRESIZABLE SPAN";
const Piece HEADER_FLAGS =
    "HIDE FLAT_BORDER FLOATING INHERIT_SIZE INHERIT_POSITION CENTER MAXIMIZE FOCUS MODAL MODELESS TOOLTIP_TIME "
    "NO_LOGPIXELS BACKGROUND PICTURE";
const Piece COLOR_FLAGS = "BACKGROUND TEXT_COLOR TOP BOTTOM RGB";
const Piece NUMBER_FLAGS = "MARGIN MARGIN_LEFT MARGIN_RIGHT MARGIN_TOP MARGIN_BOTTOM SPAN";

const Piece DIALOG_KINDS[] = {"WINDOW", "DIALOG_SYS", "FLAT_BORDER", "FLAT", "POPUP", "FLOATING", "FLOAT", "DIALOG"};
const Piece NAVIGATION[] = {"ID_NEXT", "ID_BACK", "ID_CANCEL", "ID_EXIT"};

// Pictures and clips of the program are flags of any name.
bool bIsResource(Piece word) { return piece::bStarts(word, "IDB_") || piece::bStarts(word, "IDA_"); }
bool bIsPictureFile(Piece word) { return word.size() > 4 && word.substr(word.size() - 4) == ".bmp"; }

// Calls take(word) for each word of a list until it returns true; whether it did.
template <class Take>
bool bAnyWord(Piece words, Take take) {
  for (Piece word; !(word = piece::Word(words)).empty(); words = piece::TrimFront(words.substr(word.size())))
    if (take(word)) return true;
  return false;
}

bool bHasWord(Piece words, Piece wanted) {
  return bAnyWord(words, [&](Piece word) { return word == wanted; });
}

std::vector<Piece> CollectFlags() {
  std::vector<Piece> flags;
  const auto add = [&](Piece word) {
    if (std::find(flags.begin(), flags.end(), word) == flags.end()) flags.push_back(word);
    return false;
  };
  bAnyWord(SHARED_FLAGS, add);
  bAnyWord(HEADER_FLAGS, add);
  for (const KindRow& row : g_kinds) bAnyWord(row.flags, add);
  return flags;
}

std::vector<Piece> CollectLineWords() {
  std::vector<Piece> words(std::begin(DIRECTIVES), std::end(DIRECTIVES));
  for (const KindRow& row : g_kinds) words.push_back(row.keyword);
  return words;
}

std::vector<EndWordRow> CollectEndWords() {
  std::vector<EndWordRow> rows = {{"END_GROUP", "GROUP"},
                                  {"START_ACTION", "START_BEFORE_DRAWING or START_AFTER_DRAWING"},
                                  {"FINISH_ACTION", "START_ACTION"}};
  for (const KindRow& row : g_parts) rows.push_back({row.endWord, row.keyword});
  for (const KindRow& row : g_kinds)
    if (!row.endWord.empty()) rows.push_back({row.endWord, row.keyword});
  return rows;
}

}  // namespace

std::span<const KindRow> ControlKinds() { return g_kinds; }

const KindRow* pFindKind(Piece keyword) {
  static const auto kinds = [] {
    std::unordered_map<Piece, const KindRow*> map;
    for (const KindRow& row : g_kinds) map[row.keyword] = &row;
    return map;
  }();
  const auto found = kinds.find(keyword);
  return found == kinds.end() ? nullptr : found->second;
}

const KindRow& ItemKind() { return g_item; }

const KindRow* pFindPart(Piece keyword) {
  for (const KindRow& row : g_parts)
    if (row.keyword == keyword) return &row;
  return nullptr;
}

std::span<const Piece> LineWords() {
  static const std::vector<Piece> words = CollectLineWords();
  return words;
}

bool bBeginsControl(Piece line) {
  static const std::unordered_set<Piece> words(LineWords().begin(), LineWords().end());
  const Piece word = piece::Word(line);
  const Piece behind = piece::TrimFront(line.substr(word.size()));
  return words.count(word) != 0 && (behind.empty() || behind.front() != '(');
}

const EndWordRow* pFindEndWord(Piece word) {
  static const std::vector<EndWordRow> rows = CollectEndWords();
  for (const EndWordRow& row : rows)
    if (row.word == word) return &row;
  return nullptr;
}

std::span<const Piece> DialogKindWords() { return DIALOG_KINDS; }

std::span<const Piece> NavigationWords() { return NAVIGATION; }

bool bKnowsFlag(const KindRow* pKind, Piece word) {
  if (bIsResource(word)) return pKind != nullptr;
  if (pKind == &g_item && bIsPictureFile(word)) return true;
  if (!pKind) return bHasWord(HEADER_FLAGS, word);
  return (pKind->traits & ANY_FLAGS) || bHasWord(pKind->flags, word) || bHasWord(SHARED_FLAGS, word);
}

bool bIsFlag(Piece word) {
  static const std::unordered_set<Piece> flags(AllFlags().begin(), AllFlags().end());
  return flags.count(word) != 0 || bIsResource(word);
}

std::span<const Piece> AllFlags() {
  static const std::vector<Piece> flags = CollectFlags();
  return flags;
}

// The longest one, because that is what the author meant if anything.
Piece FlagWithin(const KindRow* pKind, Piece word) {
  Piece found;
  const auto search = [&](Piece flag) {
    if (word.find(flag) != Piece::npos && flag.size() > found.size()) found = flag;
    return false;
  };
  bAnyWord(pKind ? SHARED_FLAGS : HEADER_FLAGS, search);
  if (pKind) bAnyWord(pKind->flags, search);
  return found;
}

bool bTakesColor(const KindRow* pKind, Piece flag) {
  return bHasWord(COLOR_FLAGS, flag) || (flag == "TRANSPARENT" && pKind && pKind->keyword == "IMAGE");
}

bool bTakesNumber(Piece flag) { return bHasWord(NUMBER_FLAGS, flag); }
