#include "foundation/CNSem.h"

#include "foundation/SocketError.h"

namespace {

const unsigned ALREADY_EXISTS = 183;  // the system's error number

// The reason of the last failed call, for one diagnostic line.
class Reason {
 public:
  Reason() { WSAGetLastErrorString(m_szText, sizeof m_szText); }
  const char* Text() const { return m_szText; }

 private:
  char m_szText[500];
};

}  // namespace

CNSem::CNSem() {
  if (!m_idSem.bCreated()) LogPrintf("ERROR: CNSem::CNSem -> m_idSem==NULL -> %s", Reason().Text());
  // The handle, not the error number, is compared: deliberate.
  if (m_idSem.Handle() == ALREADY_EXISTS)
    LogPrintf("ERROR: CNSem::CNSem -> m_idSem==ERROR_ALREADY_EXISTS -> %s", Reason().Text());
}

CNSem::~CNSem() {
  if (m_idSem.bCreated() && !m_idSem.bClose())
    LogPrintf("ERROR: CNSem::~CNSem -> !CloseHandle(m_idSem) -> %s", Reason().Text());
}

void CNSem::GetSem() {
  if (m_idSem.bCreated() && !m_idSem.bWait())
    LogPrintf("ERROR: CNSem::GetSem -> WaitForSingleObject(m_idSem, INFINITE)==WAIT_FAILED -> %s", Reason().Text());
}

void CNSem::ReleaseSem() {
  if (m_idSem.bCreated() && !m_idSem.bRelease())
    LogPrintf("ERROR: CNSem::ReleaseSem -> !ReleaseSemaphore -> %s", Reason().Text());
}
