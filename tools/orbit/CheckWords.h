// The words of the script language as a check needs them: what each control kind takes, the flags that all share, and
// the names that come from outside of a script.
#pragma once

#include <span>

#include "CheckText.h"

// What a line of a dialog's control part can be.
enum KindTrait : unsigned {
  TAKES_FOCUS = 1,  // the keyboard can reach it
  HOLDS_VALUE = 2,  // a field: it sets the variable of its name
  KEEPS_VALUE = 4,  // a field only with the flag REMEMBER
  MNEMONIC = 8,     // '&' in its caption marks a letter
  SIZED = 16,       // four numbers are expected
  STRINGS = 32,     // its quoted texts are items
  CONTAINER = 64,   // other controls stand between its line and its end word
  NO_WINDOW = 256,  // not a place in the order of the controls
  OWN_WORDS = 512,  // words stand before its size
  ANY_FLAGS = 1024,
  CLICKED = 2048,         // a press is all that it is for
  RUNS_ACTION = 4096,     // chosen or pressed as a key: it runs its own command, not an event's
  NAMES_COMMAND = 8192,   // its items' names are commands
  NAMES_CONTROL = 16384,  // its name, or its caption when it has a window, is that of another control
};

struct KindRow {
  Piece keyword;
  unsigned traits;
  Piece flags;    // its own, separated by blanks
  Piece events;   // suffixes, separated by blanks
  Piece endWord;  // of the lines that belong to it; empty for a kind of one line
};

// The control kinds, containers too. The directives (GROUP, actions, tables) are no kinds.
std::span<const KindRow> ControlKinds();
const KindRow* pFindKind(Piece keyword);
// What the lines of a block are, and the blocks that stand within a container or a block only.
const KindRow& ItemKind();
const KindRow* pFindPart(Piece keyword);
// Every word that a line of a dialog may begin with.
std::span<const Piece> LineWords();
// A line that begins with one of them and is no command: MESSAGE_BOX is both.
bool bBeginsControl(Piece line);
// Words that end something, with what they end.
struct EndWordRow {
  Piece word, beginning;
};
const EndWordRow* pFindEndWord(Piece word);

// The kind words of a dialog's header, in the order in which the loader tests them.
std::span<const Piece> DialogKindWords();
std::span<const Piece> NavigationWords();

// Flags that a control of the kind, or a header (null), knows.
bool bKnowsFlag(const KindRow* pKind, Piece word);
// Whether any kind knows the flag.
bool bIsFlag(Piece word);
std::span<const Piece> AllFlags();
// The flag that the engine finds within a longer unknown word, because it searches for flags anywhere; or empty.
Piece FlagWithin(const KindRow* pKind, Piece word);
bool bTakesColor(const KindRow* pKind, Piece flag);
bool bTakesNumber(Piece flag);
