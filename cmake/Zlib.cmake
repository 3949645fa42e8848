# zlib from Debian, static, for both targets: an interface target "zlib".
add_library(zlib INTERFACE)
if(WIN32)
  find_library(ORBIT_ZLIB NAMES libz.a REQUIRED)
else()
  find_library(ORBIT_ZLIB NAMES z REQUIRED)
endif()
target_link_libraries(zlib INTERFACE ${ORBIT_ZLIB})
