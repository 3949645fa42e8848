// Result codes shared by every floor, and the identifiers of the wizard's own commands.
#pragma once

// Returned by every function whose name starts with `i`. Anything but EVERYTHING_IS_OK means that the call did not do
// its work and that one diagnostic line says why.
enum ResultCode : int {
  EVERYTHING_IS_OK = 0,
  PRECONDITIONS_NOT_VALID = 1,   // a required argument is missing; nothing was changed
  POSTCONDITIONS_NOT_VALID = 2,  // a result could not be produced in the required form
  FILE_COULD_NOT_BE_OPEN = 7,
  FILE_COULD_NOT_BE_OPENED = 7,  // the second spelling that diagnostic lines use
  FUNCTION_ERROR = 9,            // a system or library call, or a sub-operation, failed
  LOG_LOCK_WAIT_FAILED = 39,
  LOG_LOCK_RELEASE_FAILED = 40,
  SYNTAX_ERROR = 46,
  REG_KEY_ERROR = 48,
};

// Command identifiers that a wizard window receives from its navigation buttons and from the engine itself.
enum NavigationId : int {
  ID_OK = 1,     // Enter
  ID_CLOSE = 2,  // Escape
  ID_NEXT = 101,
  ID_BACK = 102,
  ID_CANCEL = 103,
  ID_EXIT = 104,
  ID_SHOW_DIALOG = 105,  // show the dialog that is now current
};

// What a command tells its caller to do next; stored beside the result code.
enum CommandResult : int {
  COMMAND_DONE = 0,      // go on; on a page's own Next button: stay
  COMMAND_NEGATIVE = 1,  // a negative answer
  COMMAND_EXIT = 2,      // end the action or the wizard
  COMMAND_CONTINUE = 5,  // save the fields and move to the next page
  COMMAND_BACK = 7,
  COMMAND_FAILED = 9,  // not done; every command starts with this value
  COMMAND_NEXT = 1001,
  COMMAND_ASSIGNED = 1002,
  COMMAND_BREAK = 1004,
  COMMAND_GO_TO_DIALOG = 1005,  // the target is the wizard's next-dialog counter
};
