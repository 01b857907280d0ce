# Warnings and sanitizers shared by every target of this project. Each flag
# goes only to the compilers that take it.
add_library(vela_build_flags INTERFACE)
set(vela_gnu_like "$<CXX_COMPILER_ID:GNU,Clang,AppleClang>")
set(vela_msvc "$<CXX_COMPILER_ID:MSVC>")
target_compile_options(vela_build_flags INTERFACE
  "$<${vela_gnu_like}:-Wall;-Wextra;-Wpedantic;-Wshadow;-Wnon-virtual-dtor;-Woverloaded-virtual>"
  "$<${vela_msvc}:/W4;/permissive->")
# Some Intel processors run a jump that crosses or ends on a 32-byte boundary
# from a slow path (the JCC erratum's microcode fix): unpadded, the same code
# ran the rational product at 30 or at 58 ns depending on where an unrelated
# change put it. Every target pads alike, so baselines and library compare fairly.
# Asked of the compiler first: older assemblers, other processors and
# multi-architecture builds go without.
if(CMAKE_CXX_COMPILER_ID MATCHES "GNU|Clang" AND CMAKE_SYSTEM_PROCESSOR MATCHES "x86_64|AMD64|i.86")
  include(CheckCXXCompilerFlag)
  if(CMAKE_CXX_COMPILER_ID STREQUAL "GNU")
    set(vela_branch_padding "-Wa,-mbranches-within-32B-boundaries")
  else()
    set(vela_branch_padding "-mbranches-within-32B-boundaries")
  endif()
  check_cxx_compiler_flag("${vela_branch_padding}" VELA_HAS_BRANCH_PADDING)
  if(VELA_HAS_BRANCH_PADDING)
    target_compile_options(vela_build_flags INTERFACE "${vela_branch_padding}")
  endif()
endif()
if(VELA_WERROR)
  target_compile_options(vela_build_flags INTERFACE $<${vela_gnu_like}:-Werror> $<${vela_msvc}:/WX>)
endif()
if(VELA_SANITIZE)
  target_compile_options(vela_build_flags INTERFACE
    "$<${vela_gnu_like}:-fsanitize=${VELA_SANITIZE};-fno-omit-frame-pointer;-fno-sanitize-recover=all>")
  target_link_options(vela_build_flags INTERFACE $<${vela_gnu_like}:-fsanitize=${VELA_SANITIZE}>)
endif()
