# Fails when a library file includes a header of a layer above its own.
# Layers from the bottom; a file belongs to the longest folder prefix that
# names it. Folders of one layer may include each other.
set(layers
  "base"
  "time/sync"
  "time/rational"
  "document/format"
  "time/parameters time/interpolaters"
  "commands/framework"
  "effects"
  "model"
  "commands/edits"
  "document"
  "scripting")

function(vela_layer_of path out)
  set(best -1)
  set(best_length 0)
  set(index 0)
  foreach(layer ${layers})
    string(REPLACE " " ";" folders "${layer}")
    foreach(folder ${folders})
      string(LENGTH "${folder}/" length)
      string(FIND "${path}" "${folder}/" position)
      if(position EQUAL 0 AND length GREATER best_length)
        set(best ${index})
        set(best_length ${length})
      endif()
    endforeach()
    math(EXPR index "${index} + 1")
  endforeach()
  set(${out} ${best} PARENT_SCOPE)
endfunction()

file(GLOB_RECURSE files RELATIVE ${ROOT}/VelaMediaLib ${ROOT}/VelaMediaLib/*.h ${ROOT}/VelaMediaLib/*.cpp)
list(REMOVE_ITEM files VelaMediaLib.h) # the umbrella header includes everything
set(violations "")
foreach(file ${files})
  vela_layer_of(${file} own)
  if(own EQUAL -1)
    list(APPEND violations "${file} is in no layer")
    continue()
  endif()
  get_filename_component(folder ${file} DIRECTORY)
  file(STRINGS ${ROOT}/VelaMediaLib/${file} includes REGEX "^[ \t]*#[ \t]*include[ \t]*[<\"]")
  foreach(line ${includes})
    string(REGEX REPLACE "^[ \t]*#[ \t]*include[ \t]*[<\"]([^>\"]+)[>\"].*" "\\1" target "${line}")
    # Library headers are named from the include root, or relative to the including file.
    if(target MATCHES "^VelaMediaLib/")
      string(REGEX REPLACE "^VelaMediaLib/" "" target "${target}")
    elseif(line MATCHES "\"" AND EXISTS ${ROOT}/VelaMediaLib/${folder}/${target})
      set(target "${folder}/${target}")
    else()
      continue() # a system or dependency header
    endif()
    cmake_path(NORMAL_PATH target)
    vela_layer_of(${target} theirs)
    if(theirs EQUAL -1 OR theirs GREATER own)
      list(APPEND violations "${file} includes ${target}")
    endif()
  endforeach()
endforeach()
if(violations)
  string(REPLACE ";" "\n  " text "${violations}")
  message(FATAL_ERROR "Includes that point up a layer:\n  ${text}")
endif()
