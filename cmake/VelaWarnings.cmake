# Warnings and sanitizers shared by every target of this project. Each flag
# goes only to the compilers that take it.
add_library(vela_build_flags INTERFACE)
set(vela_gnu_like "$<CXX_COMPILER_ID:GNU,Clang,AppleClang>")
set(vela_msvc "$<CXX_COMPILER_ID:MSVC>")
target_compile_options(vela_build_flags INTERFACE
  "$<${vela_gnu_like}:-Wall;-Wextra;-Wpedantic;-Wshadow;-Wnon-virtual-dtor;-Woverloaded-virtual>"
  "$<${vela_msvc}:/W4;/permissive->")
if(VELA_WERROR)
  target_compile_options(vela_build_flags INTERFACE $<${vela_gnu_like}:-Werror> $<${vela_msvc}:/WX>)
endif()
if(VELA_SANITIZE)
  target_compile_options(vela_build_flags INTERFACE
    "$<${vela_gnu_like}:-fsanitize=${VELA_SANITIZE};-fno-omit-frame-pointer;-fno-sanitize-recover=all>")
  target_link_options(vela_build_flags INTERFACE $<${vela_gnu_like}:-fsanitize=${VELA_SANITIZE}>)
endif()
