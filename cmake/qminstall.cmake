# Install and export, so that another project can find_package(qm_rps) and link qm::rps.
include(CMakePackageConfigHelpers)

set(rooms qm_base qm_solver qm_db qm_cmd qm_rps)
if(QM_UI)
  list(APPEND rooms qm_ui)
endif()
install(TARGETS ${rooms} EXPORT qm_rpsTargets ARCHIVE DESTINATION ${CMAKE_INSTALL_LIBDIR}
        COMPONENT dev)
foreach(room ${rooms})
  install(DIRECTORY ${PROJECT_SOURCE_DIR}/src/${room} DESTINATION ${CMAKE_INSTALL_INCLUDEDIR}
          COMPONENT dev
          FILES_MATCHING PATTERN "*.h")
endforeach()
install(EXPORT qm_rpsTargets NAMESPACE qm:: DESTINATION ${CMAKE_INSTALL_LIBDIR}/cmake/qm_rps
        COMPONENT dev)

configure_package_config_file(
  ${PROJECT_SOURCE_DIR}/cmake/qm_rpsConfig.cmake.in ${PROJECT_BINARY_DIR}/qm_rpsConfig.cmake
  INSTALL_DESTINATION ${CMAKE_INSTALL_LIBDIR}/cmake/qm_rps)
write_basic_package_version_file(${PROJECT_BINARY_DIR}/qm_rpsConfigVersion.cmake
                                 COMPATIBILITY SameMinorVersion)
install(FILES ${PROJECT_BINARY_DIR}/qm_rpsConfig.cmake
              ${PROJECT_BINARY_DIR}/qm_rpsConfigVersion.cmake
        DESTINATION ${CMAKE_INSTALL_LIBDIR}/cmake/qm_rps COMPONENT dev)
