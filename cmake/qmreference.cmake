# The target "docs": the reference of the library. Doxygen is only run, no part of the product.
find_program(QM_DOXYGEN doxygen)
find_package(Python3 COMPONENTS Interpreter)
if(QM_DOXYGEN AND Python3_FOUND)
  set(QM_REFERENCE ${PROJECT_BINARY_DIR}/reference)
  set(QM_REFERENCE_INPUT ${PROJECT_SOURCE_DIR}/cmake/reference.md)
  foreach(room qm_base qm_solver qm_db qm_cmd qm_rps)
    string(APPEND QM_REFERENCE_INPUT " ${PROJECT_SOURCE_DIR}/src/${room}")
  endforeach()
  configure_file(${PROJECT_SOURCE_DIR}/cmake/Doxyfile.in ${PROJECT_BINARY_DIR}/Doxyfile @ONLY)
  add_custom_target(docs
    COMMAND ${CMAKE_COMMAND} -DDOXYGEN=${QM_DOXYGEN} -DFILE=${PROJECT_BINARY_DIR}/Doxyfile
            -DFOLDER=${QM_REFERENCE} -P ${PROJECT_SOURCE_DIR}/cmake/reference.cmake
    COMMENT "Writing the reference" VERBATIM)
else()
  add_custom_target(docs COMMAND ${CMAKE_COMMAND} -E echo
    "The reference needs doxygen, which is not installed." COMMAND ${CMAKE_COMMAND} -E false)
endif()
