// Line-oriented byte streams: a file (CNFile) and a growable block of memory (CNBuffer). Every operation takes the
// caller's function name and the name of the variable concerned, used only in diagnostic lines.
#pragma once

#include <cstdio>

#include "foundation/CNSem.h"
#include "foundation/CNString.h"

class CNStream {
 public:
  CNStream();
  virtual ~CNStream() = default;
  CNStream(const CNStream&) = delete;
  CNStream& operator=(const CNStream&) = delete;

  // Clears the trim flag and the line separator; a buffer frees its data instead. Returns 0.
  virtual int iReset();
  // Copies out up to lMaxReadBufferLength bytes. Returns the count, 0 at the end, -1 on failure.
  virtual long Read(const char* szFunction, const char* szVariable, char* szBuffer, long lMaxReadBufferLength) = 0;
  // Appends lBufferLength bytes (at least 1). Returns the count, or -1.
  virtual long Write(const char* szFunction, const char* szVariable, const char* szBuffer, long lBufferLength) = 0;
  // The next line, without its line end while the trim flag is set; null at the end. Valid until the next call.
  // iTimeOut must be at least 1 and has no other effect.
  virtual const char* ReadLine(const char* szFunction, const char* szVariable, int iTimeOut) = 0;
  // Write the formatted text; return the count written (0 for an empty result), or -1.
  long Printf(const char* szFunction, const char* szVariable, const char* szFormat, ...) ORBIT_PRINTF(4, 5);
  virtual long vPrintf(const char* szFunction, const char* szVariable, const char* szFormat, va_list args);

  // When set (as after construction) ReadLine removes the line's trailing CR and LF.
  void SetTrim(bool bTrim) { m_bTrim = bTrim ? 1 : 0; }

 protected:
  const char* KeepLine(const char* pLine, long lLength);

  CNString m_csLine;
  const char* m_szSeparator;
  int m_bTrim;
};

// A growable block with separate read and write positions. Not synchronised.
class CNBuffer : public CNStream {
 public:
  ~CNBuffer() override;

  int iReset() override;
  long Read(const char* szFunction, const char* szVariable, char* szBuffer, long lMaxReadBufferLength) override;
  long Write(const char* szFunction, const char* szVariable, const char* szBuffer, long lBufferLength) override;
  const char* ReadLine(const char* szFunction, const char* szVariable, int iTimeOut) override;

  // Sets the capacity to lSize rounded up to a multiple of 4096. On failure the data stay as they were.
  void Resize(long lSize);
  const char* Ptr() const { return m_szBuffer; }
  long Length() const { return m_lDataLength; }
  long Capacity() const { return m_lBufferSize; }

 private:
  bool bReallocate(long lSize);

  char* m_szBuffer = nullptr;
  long m_lBufferSize = 0;
  long m_lDataLength = 0;
  long m_lReadPosition = 0;
};

// A file opened through the C runtime's buffered functions. Open, Close, Write, both lRead forms and ReadLine run under
// the object's own lock and may be called from several threads; Printf, lGetNumLines and lSize do not take it.
class CNFile : public CNStream {
 public:
  CNFile() = default;
  // As Open; the object is left closed on failure.
  CNFile(const char* file, const char* type);
  ~CNFile() override;

  // type is the C runtime's mode string. A null file reopens the last name. Returns 1 when open, else 0.
  int Open(const char* file, const char* type);
  void Close();
  int bFileOpened() const { return m_bOpened; }
  // 1 once a read or a write of the open file has failed: what tells a failed ReadLine from one at the end.
  int bFailed() const { return m_File && std::ferror(m_File) ? 1 : 0; }

  long Read(const char* szFunction, const char* szVariable, char* szBuffer, long lMaxReadBufferLength) override;
  long Write(const char* szFunction, const char* szVariable, const char* szBuffer, long lBufferLength) override;
  const char* ReadLine(const char* szFunction, const char* szVariable, int iTimeOut) override;
  long vPrintf(const char* szFunction, const char* szVariable, const char* szFormat, va_list args) override;

  // Reads up to max bytes; the count, or -1.
  long lRead(const char* szFunction, const char* szVariable, char* szBuffer, long lMax);
  // Reads the rest of the file into csOut; the count, or -1 for a closed or an empty file.
  long lRead(CNString& csOut);
  // Lines from the current position, which is restored; -1 when closed.
  long lGetNumLines();
  // Size in bytes, the position restored; -1 when closed.
  long lSize();

 private:
  void CloseLocked();

  FILE* m_File = nullptr;
  CNString m_csFileName;
  int m_bOpened = 0;
  CNSem m_sem;
};
