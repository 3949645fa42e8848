// Carries the headers that all test programs share (tests/CMakeLists.txt); a library needs a source.
