# Prints what a program takes without its pictures, and fails above the bound.
# cmake "-DNAME=Setup program" -DPROGRAM=setup.exe -DPICTURES="a;b" -DBOUND=bytes -P CheckSize.cmake
file(SIZE ${PROGRAM} size)
foreach(picture ${PICTURES})
  file(SIZE ${picture} picture_size)
  math(EXPR size "${size} - ${picture_size}")
endforeach()
message("${NAME}, stripped, without payload and pictures: ${size} bytes (bound ${BOUND})")
if(size GREATER BOUND)
  message(FATAL_ERROR "${PROGRAM} is larger than ${BOUND} bytes.")
endif()
