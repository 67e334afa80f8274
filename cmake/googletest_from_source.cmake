# GoogleTest compiled with the build's own compiler and flags from Debian's `googletest` sources,
# for the builds Debian ships no prebuilt copy for (32-bit).
set(BUILD_GMOCK OFF CACHE BOOL "" FORCE)
set(INSTALL_GTEST OFF CACHE BOOL "" FORCE)
add_subdirectory(${PANDEX_GTEST_SOURCE_DIR} ${CMAKE_BINARY_DIR}/googletest EXCLUDE_FROM_ALL)
foreach(library gtest gtest_main)
  # Its sources are not held to the project's warning flags.
  set_property(TARGET ${library} PROPERTY COMPILE_OPTIONS -w)
endforeach()
