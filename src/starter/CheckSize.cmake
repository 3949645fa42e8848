# Prints what the setup program takes without its pictures, and fails above the bound.
# cmake -DPROGRAM=setup.exe -DPICTURES="a;b" -DBOUND=bytes -P CheckSize.cmake
file(SIZE ${PROGRAM} size)
foreach(picture ${PICTURES})
  file(SIZE ${picture} picture_size)
  math(EXPR size "${size} - ${picture_size}")
endforeach()
message("Setup program, stripped, without payload and pictures: ${size} bytes (bound ${BOUND})")
if(size GREATER BOUND)
  message(FATAL_ERROR "The setup program is larger than ${BOUND} bytes.")
endif()
