#include "foundation/SocketError.h"

#ifdef _WIN32
#include <winsock2.h>
#else
#include <cerrno>
#endif

#include <gtest/gtest.h>

#include <string>

namespace {

std::string Text(unsigned uError, int iSize = 500) {
  std::string buffer(size_t(iSize) + 1, '#');
#ifdef _WIN32
  SetLastError(uError);
#else
  errno = int(uError);
#endif
  EXPECT_EQ(WSAGetLastErrorString(&buffer[0], iSize), 0);
  EXPECT_EQ(buffer[size_t(iSize)], '#') << "written beyond the buffer";
  return buffer.c_str();
}

}  // namespace

TEST(SocketError, TellsKnownAndUnknownErrorsAndCutsThem) {
  EXPECT_EQ(Text(6), "WSA_INVALID_HANDLE: Specified event object handle is invalid.");
  EXPECT_EQ(Text(10048), "WSAEADDRINUSE: Address already in use.");
  EXPECT_EQ(Text(10049), "WSAEADDRINUSE: Cannot assign requested address.");
  EXPECT_EQ(Text(10107), "WSASYSCALLFAILURE: System call failure.");
  EXPECT_EQ(Text(11004), "WSANO_DATA: Valid name, no data record of requested type.");
  EXPECT_EQ(Text(0), "unknown error (0)");
  EXPECT_EQ(Text(11005), "unknown error (11005)");
  EXPECT_EQ(Text(10060, 10), "WSAETIMED");
  EXPECT_EQ(Text(4711, 10), "unknown e");
}

#ifdef _WIN32
TEST(SocketError, HoldsTheNumbersOfWindowsSockets) {
#define ROW(name) \
  { name, #name ": " }
  // clang-format off
  const struct { int iError; const char* szName; } rows[] = {
      ROW(WSA_INVALID_HANDLE), ROW(WSA_NOT_ENOUGH_MEMORY), ROW(WSA_INVALID_PARAMETER), ROW(WSA_OPERATION_ABORTED),
      ROW(WSA_IO_INCOMPLETE), ROW(WSA_IO_PENDING), ROW(WSAEINTR), ROW(WSAEACCES), ROW(WSAEFAULT), ROW(WSAEINVAL),
      ROW(WSAEMFILE), ROW(WSAEWOULDBLOCK), ROW(WSAEINPROGRESS), ROW(WSAEALREADY), ROW(WSAENOTSOCK),
      ROW(WSAEDESTADDRREQ), ROW(WSAEMSGSIZE), ROW(WSAEPROTOTYPE), ROW(WSAENOPROTOOPT), ROW(WSAEPROTONOSUPPORT),
      ROW(WSAESOCKTNOSUPPORT), ROW(WSAEOPNOTSUPP), ROW(WSAEPFNOSUPPORT), ROW(WSAEAFNOSUPPORT), ROW(WSAEADDRINUSE),
      ROW(WSAENETDOWN), ROW(WSAENETUNREACH), ROW(WSAENETRESET), ROW(WSAECONNABORTED), ROW(WSAECONNRESET),
      ROW(WSAENOBUFS), ROW(WSAEISCONN), ROW(WSAENOTCONN), ROW(WSAESHUTDOWN), ROW(WSAETIMEDOUT), ROW(WSAECONNREFUSED),
      ROW(WSAEHOSTDOWN), ROW(WSAEHOSTUNREACH), ROW(WSAEPROCLIM), ROW(WSASYSNOTREADY), ROW(WSAVERNOTSUPPORTED),
      ROW(WSANOTINITIALISED), ROW(WSAEDISCON), ROW(WSATYPE_NOT_FOUND), ROW(WSAHOST_NOT_FOUND), ROW(WSATRY_AGAIN),
      ROW(WSANO_RECOVERY), ROW(WSANO_DATA), ROW(WSASYSCALLFAILURE),
  };
  // clang-format on
#undef ROW
  for (const auto& row : rows) EXPECT_EQ(Text(unsigned(row.iError)).find(row.szName), 0u) << row.szName;
  EXPECT_EQ(sizeof rows / sizeof rows[0] + 1, 50u) << "all but the second WSAEADDRINUSE";
  EXPECT_EQ(WSAEADDRNOTAVAIL, 10049);
}
#endif
