# A room's sources include files by their path from the repository's root. What a room may include
# is decided here: each room that it may see is linked, alone, into an include folder of its own.
function(tavro_room target)
  foreach(room IN LISTS ARGN)
    set(folder ${CMAKE_BINARY_DIR}/rooms/${room})
    if(NOT EXISTS ${folder}/${room})
      file(MAKE_DIRECTORY ${folder})
      file(CREATE_LINK ${CMAKE_SOURCE_DIR}/${room} ${folder}/${room} SYMBOLIC)
    endif()
    target_include_directories(${target} PRIVATE ${folder})
  endforeach()
  target_compile_options(${target} PRIVATE -Wall -Wextra -Wpedantic -Werror)
  if(CMAKE_CXX_COMPILER_ID STREQUAL "GNU")
    # g++ 12 sees overlapping copies in plain string concatenation where there are none.
    target_compile_options(${target} PRIVATE -Wno-restrict)
  endif()
endfunction()
