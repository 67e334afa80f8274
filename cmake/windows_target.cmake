# 32-bit Windows: the plug-in as Pandex.dll, exporting its entry, over the host's libraries made
# from the workbench (QELDLL.dll, QELINFO.dll, DsgMode.dll), and the journey in tests/windows
# that loads Pandex.dll as the host does, run by CTest under wine.
#
# Drawing files are left out of the Windows host: Debian has no SQLite for MinGW, and the
# journey keeps its drawing in memory. Everything else of the workbench is there.

# QELDLL.dll: the workbench less its drawing files and less the calls of the sibling libraries.
get_target_property(workbench_sources pandex_workbench SOURCES)
set(qelinfo_sources ${workbench_sources})
set(dsgmode_sources ${workbench_sources})
list(FILTER workbench_sources EXCLUDE REGEX "/(drawing_file[a-z_]*|host_info|host_design_mode)\\.cpp$")
list(FILTER qelinfo_sources INCLUDE REGEX "/host_info\\.cpp$")
list(FILTER dsgmode_sources INCLUDE REGEX "/host_design_mode\\.cpp$")
set_property(TARGET pandex_workbench PROPERTY SOURCES ${workbench_sources})
set_target_properties(pandex_workbench PROPERTIES OUTPUT_NAME QELDLL)
target_compile_definitions(pandex_workbench PRIVATE PANDEX_BUILDING_QELDLL)

add_library(QELINFO SHARED ${qelinfo_sources})
add_library(DsgMode SHARED ${dsgmode_sources})
foreach(library QELINFO DsgMode)
  target_link_libraries(${library} PRIVATE pandex_workbench)
endforeach()

# The host's libraries and the journey share C++ objects and exceptions, so they share one C++
# runtime (libstdc++-6.dll and its companions, copied beside them). Everything of theirs is
# exported, as the host's own C++ interface is to whoever links it.
foreach(library pandex_workbench QELINFO DsgMode)
  set_target_properties(${library} PROPERTIES PREFIX "")
  target_link_options(${library} PRIVATE -Wl,--export-all-symbols)
endforeach()

# Pandex.dll meets the host through C calls and the argument blocks only, and carries its own
# C++ runtime inside, so the host needs nothing of ours beside it.
target_link_libraries(pandex_plugin INTERFACE pandex_workbench QELINFO DsgMode)
# The whole plug-in goes in, not only what its entry reaches today, so every host call it makes
# is resolved against the host's libraries when the library is linked.
add_library(Pandex SHARED shell/dll_main.cpp)
target_link_libraries(Pandex PRIVATE "$<LINK_LIBRARY:WHOLE_ARCHIVE,pandex_plugin>")
set_target_properties(Pandex PROPERTIES PREFIX "")
target_link_options(Pandex PRIVATE -static)

# The C++ runtime the host's libraries share, beside them.
foreach(runtime libstdc++-6.dll libgcc_s_dw2-1.dll libwinpthread-1.dll)
  execute_process(COMMAND ${CMAKE_CXX_COMPILER} -print-file-name=${runtime}
                  OUTPUT_VARIABLE runtime_path OUTPUT_STRIP_TRAILING_WHITESPACE)
  file(COPY ${runtime_path} DESTINATION ${CMAKE_BINARY_DIR})
endforeach()
# One folder holds every library and program, as the host's own folder would.
set_target_properties(pandex_workbench QELINFO DsgMode Pandex PROPERTIES RUNTIME_OUTPUT_DIRECTORY ${CMAKE_BINARY_DIR})

if(PANDEX_TESTS)
  enable_testing()
  add_subdirectory(tests/windows)
endif()
