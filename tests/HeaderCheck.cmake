# Every public header compiles on its own: one generated source per header, each including only
# that header, built into one object library (part of the default build, so a header that forgets
# an include breaks the build).
file(GLOB_RECURSE QUORVEX_PUBLIC_HEADERS CONFIGURE_DEPENDS ${PROJECT_SOURCE_DIR}/include/*.h)
set(header_sources)
foreach(header ${QUORVEX_PUBLIC_HEADERS})
  file(RELATIVE_PATH rel ${PROJECT_SOURCE_DIR}/include ${header})
  string(MAKE_C_IDENTIFIER ${rel} id)
  set(src ${CMAKE_CURRENT_BINARY_DIR}/header_check/${id}.cpp)
  file(CONFIGURE OUTPUT ${src} CONTENT "#include \"${rel}\"\n#include \"${rel}\"\n")
  list(APPEND header_sources ${src})
endforeach()
add_library(header_check OBJECT ${header_sources})
target_include_directories(header_check PRIVATE ${PROJECT_SOURCE_DIR}/include)
target_link_libraries(header_check PRIVATE ACE::ACE)
