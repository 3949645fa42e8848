// Where the portable floors send what a person must read: the one message-box call that parsers and the engine use.
#pragma once

enum class MessageIcon { None, Error, Question, Exclamation, Information };
enum class MessageButtons { Ok, OkCancel, AbortRetryIgnore, YesNoCancel, YesNo, RetryCancel, CancelTryContinue };

// The system's numbers for the answers.
enum MessageAnswer : int {
  ANSWER_OK = 1,
  ANSWER_CANCEL = 2,
  ANSWER_ABORT = 3,
  ANSWER_RETRY = 4,
  ANSWER_IGNORE = 5,
  ANSWER_YES = 6,
  ANSWER_NO = 7,
  ANSWER_TRY_AGAIN = 10,
  ANSWER_CONTINUE = 11,
};

struct MessageText {
  const char* szText;     // code page 1250, may hold line feeds
  const char* szCaption;  // null: the system's default caption
  MessageIcon icon = MessageIcon::None;
  MessageButtons buttons = MessageButtons::Ok;
  bool bOwned = true;  // false: no owner window
};

class MessageSink {
 public:
  virtual ~MessageSink() = default;
  // Shows the message and waits for the answer. Any thread.
  virtual int iShowMessage(const MessageText& message) = 0;
};
