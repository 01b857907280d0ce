# Warnings and sanitizers shared by every target of this project.
add_library(vela_build_flags INTERFACE)
target_compile_options(vela_build_flags INTERFACE
  -Wall -Wextra -Wpedantic -Wshadow -Wnon-virtual-dtor -Woverloaded-virtual)
if(VELA_WERROR)
  target_compile_options(vela_build_flags INTERFACE -Werror)
endif()
if(VELA_SANITIZE)
  target_compile_options(vela_build_flags INTERFACE
    -fsanitize=${VELA_SANITIZE} -fno-omit-frame-pointer -fno-sanitize-recover=all)
  target_link_options(vela_build_flags INTERFACE -fsanitize=${VELA_SANITIZE})
endif()
