# Flags every target of the project links to.
add_library(kickvane_warnings INTERFACE)
target_compile_options(kickvane_warnings INTERFACE -Wall -Wextra -Wpedantic)
if(KICKVANE_WERROR)
  target_compile_options(kickvane_warnings INTERFACE -Werror)
endif()
if(WIN32 AND CMAKE_CXX_COMPILER_ID STREQUAL "GNU" AND CMAKE_CXX_COMPILER_VERSION VERSION_LESS 13)
  # WORKAROUND: GCC 12 warns wrongly about std::string concatenation at -O3
  # (https://gcc.gnu.org/bugzilla/show_bug.cgi?id=105329).
  target_compile_options(kickvane_warnings INTERFACE -Wno-restrict)
endif()
