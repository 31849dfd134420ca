# Flags every target of the project links to.
add_library(kickvane_warnings INTERFACE)
target_compile_options(kickvane_warnings INTERFACE -Wall -Wextra -Wpedantic)
if(KICKVANE_WERROR)
  target_compile_options(kickvane_warnings INTERFACE -Werror)
endif()
