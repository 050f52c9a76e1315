# Every header stands alone: a source of its own name includes it first, or it is parsed here, all of
# them in one step of the build.
find_package(Python3 REQUIRED COMPONENTS Interpreter)
find_package(Eigen3 3.4 REQUIRED NO_MODULE)
if(QM_UI)
  find_package(Qt6 REQUIRED COMPONENTS Core Gui Widgets PrintSupport)
endif()
file(GLOB_RECURSE headers CONFIGURE_DEPENDS ${PROJECT_SOURCE_DIR}/src/*.h)
set(stamp ${CMAKE_CURRENT_BINARY_DIR}/headers.stamp)
set(header_flags -std=c++20 -I${PROJECT_SOURCE_DIR}/src)
set(header_libraries Eigen3::Eigen)
if(QM_UI)
  list(APPEND header_flags -DQM_UI)
  list(APPEND header_libraries Qt6::Core Qt6::Gui Qt6::Widgets Qt6::PrintSupport)
endif()
foreach(library ${header_libraries})
  list(APPEND header_includes $<TARGET_PROPERTY:${library},INTERFACE_INCLUDE_DIRECTORIES>)
endforeach()
add_custom_command(
  OUTPUT ${stamp}
  COMMAND Python3::Interpreter ${PROJECT_SOURCE_DIR}/cmake/checkheaders.py ${PROJECT_SOURCE_DIR}
          ${stamp} ${CMAKE_CXX_COMPILER} ${header_flags}
          "-isystem$<JOIN:${header_includes},;-isystem>"
  DEPENDS ${headers} ${PROJECT_SOURCE_DIR}/cmake/checkheaders.py
  COMMENT "Parsing headers alone"
  COMMAND_EXPAND_LISTS VERBATIM)
add_custom_target(qm_header_check ALL DEPENDS ${stamp})
