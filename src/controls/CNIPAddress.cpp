#include "controls/SimpleKinds.h"

// The caption is the first value, as "192.168.0.1".
const SimpleKind g_CNIPAddress = {.kind = ControlKind::IpAddress,
                                  .szKeyword = "IPADDRESS",
                                  .szClassName = "CNIPAddress",
                                  .szWindowClass = "SysIPAddress32"};
