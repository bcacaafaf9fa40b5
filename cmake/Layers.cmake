# One static library per layer. A layer's headers are reached through an include root of its own
# that holds links to its folders' headers and nothing else, so a target sees only its own headers
# and those of the layers it links: an include that climbs a layer fails to compile.
#
#   kg_add_layer(kg_builders FOLDERS builders USES kg_chart)
#   kg_add_layer(kg_cli FOLDERS apps/cli EXCLUDE main.cpp USES kg_capi)   # main() stays out
function(kg_add_layer target)
  cmake_parse_arguments(L "" "" "FOLDERS;EXCLUDE;USES;PRIVATE_USES" ${ARGN})
  set(root ${CMAKE_BINARY_DIR}/layers/${target})
  file(REMOVE_RECURSE ${root})
  set(sources)
  foreach(folder IN LISTS L_FOLDERS)
    file(GLOB headers CONFIGURE_DEPENDS ${CMAKE_SOURCE_DIR}/${folder}/*.h)
    file(GLOB cpps CONFIGURE_DEPENDS ${CMAKE_SOURCE_DIR}/${folder}/*.cpp)
    foreach(excluded IN LISTS L_EXCLUDE)
      list(REMOVE_ITEM cpps ${CMAKE_SOURCE_DIR}/${folder}/${excluded})
    endforeach()
    list(APPEND sources ${cpps} ${headers})
    file(MAKE_DIRECTORY ${root}/${folder})
    foreach(header IN LISTS headers)
      get_filename_component(name ${header} NAME)
      # Links, not copies: an edited header is seen at once.
      file(CREATE_LINK ${header} ${root}/${folder}/${name} SYMBOLIC)
    endforeach()
  endforeach()
  add_library(${target} STATIC ${sources})
  target_include_directories(${target} PUBLIC $<BUILD_INTERFACE:${root}>)
  target_link_libraries(${target} PUBLIC ${L_USES} PRIVATE ${L_PRIVATE_USES})
  kg_set_warnings(${target})
endfunction()
