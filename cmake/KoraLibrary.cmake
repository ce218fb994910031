# One folder is one library. A library sees only the folders it names, so that the build
# refuses an include that looks up or sideways.
#
#   kora_library(<name> [QT] [MODULE] [FOLDERS <folder>...] [DEPENDS <library>...])
#
# FOLDERS: folders below that are part of it.
# QT: the folder may use Qt Widgets, printing and SVG.
# MODULE: it may become part of a module that a program loads.
function(kora_library name)
  cmake_parse_arguments(ARG "QT;MODULE" "" "FOLDERS;DEPENDS" ${ARGN})
  file(GLOB sources CONFIGURE_DEPENDS *.cpp *.h)
  foreach(folder ${ARG_FOLDERS})
    file(GLOB more CONFIGURE_DEPENDS ${folder}/*.cpp ${folder}/*.h)
    list(APPEND sources ${more})
  endforeach()
  add_library(${name} STATIC ${sources})
  # A folder's headers are reached as "folder/header.h" through a tree of links, one root a
  # library, so that a library's own dependencies are all that it can include.
  # Folders of src/ are named without it, a folder beside it by its own name.
  file(RELATIVE_PATH place ${CMAKE_SOURCE_DIR} ${CMAKE_CURRENT_SOURCE_DIR})
  string(REGEX REPLACE "^src/" "" place ${place})
  set(root ${CMAKE_BINARY_DIR}/include/${name})
  get_filename_component(parent ${root}/${place} DIRECTORY)
  file(MAKE_DIRECTORY ${parent})
  file(CREATE_LINK ${CMAKE_CURRENT_SOURCE_DIR} ${root}/${place} SYMBOLIC)
  target_include_directories(${name} PUBLIC ${root})
  target_link_libraries(${name} PUBLIC ${ARG_DEPENDS})
  if(ARG_MODULE)
    set_target_properties(${name} PROPERTIES POSITION_INDEPENDENT_CODE ON)
    target_compile_options(${name} PRIVATE -fno-semantic-interposition)
  elseif(ARG_QT)
    kora_use_pch(${name} qt)
  else()
    kora_use_pch(${name} core)
  endif()
  if(ARG_QT)
    set_target_properties(${name} PROPERTIES AUTOMOC ON AUTORCC ON)
    target_link_libraries(${name} PUBLIC Qt6::Widgets Qt6::PrintSupport Qt6::Svg)
    target_compile_definitions(${name} PUBLIC QT_NO_KEYWORDS)
    target_compile_options(${name} PRIVATE -Wno-shadow -Wno-conversion)
  endif()
endfunction()
