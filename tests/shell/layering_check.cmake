# The window reaches the core only through the session: no file of the shell includes a header of
# the patch road (engine) or of the game's whereabouts (game), and none writes the settings file.
# Run as: cmake -DSHELL_DIR=<src/shell> -P layering_check.cmake
file(GLOB sources "${SHELL_DIR}/*.h" "${SHELL_DIR}/*.cpp")
set(problems "")
foreach(source IN LISTS sources)
  file(STRINGS "${source}" lines REGEX "#include \"(engine|game)/|#include \"catalog/(ini|settings)\\.h\"|WriteIni|SaveSettings|IniDocument")
  foreach(line IN LISTS lines)
    string(APPEND problems "\n  ${source}: ${line}")
  endforeach()
endforeach()
if(problems)
  message(FATAL_ERROR "The shell goes round the session:${problems}")
endif()
list(LENGTH sources count)
message(STATUS "${count} shell files reach the core through the session only")
