# Installs the library as the package `tarnkiln`, for find_package(tarnkiln) by other projects.
# The headers come from the file sets of the targets; what lies in internal/ is in none of them.

include(CMakePackageConfigHelpers)

set(TARNKILN_PACKAGE_DIR ${CMAKE_INSTALL_LIBDIR}/cmake/tarnkiln)
set(TARNKILN_METAGEN_DIR ${CMAKE_INSTALL_DATADIR}/tarnkiln/metagen)
set(TARNKILN_INSTALLED_TARGETS tarnkiln tarnkiln_except)

set_target_properties(${TARNKILN_INSTALLED_TARGETS} PROPERTIES INSTALL_RPATH "$ORIGIN")
install(TARGETS ${TARNKILN_INSTALLED_TARGETS}
    EXPORT tarnkilnTargets
    LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR}
    INCLUDES DESTINATION ${CMAKE_INSTALL_INCLUDEDIR}
    FILE_SET HEADERS DESTINATION ${CMAKE_INSTALL_INCLUDEDIR})
install(EXPORT tarnkilnTargets NAMESPACE tarnkiln:: DESTINATION ${TARNKILN_PACKAGE_DIR})

configure_package_config_file(
    ${CMAKE_CURRENT_LIST_DIR}/tarnkilnConfig.cmake.in ${PROJECT_BINARY_DIR}/tarnkilnConfig.cmake
    INSTALL_DESTINATION ${TARNKILN_PACKAGE_DIR}
    PATH_VARS TARNKILN_METAGEN_DIR)
write_basic_package_version_file(${PROJECT_BINARY_DIR}/tarnkilnConfigVersion.cmake
    COMPATIBILITY SameMinorVersion)
install(FILES
    ${PROJECT_BINARY_DIR}/tarnkilnConfig.cmake
    ${PROJECT_BINARY_DIR}/tarnkilnConfigVersion.cmake
    ${CMAKE_CURRENT_LIST_DIR}/TarnkilnMetamodel.cmake
    DESTINATION ${TARNKILN_PACKAGE_DIR})
install(FILES ${PROJECT_SOURCE_DIR}/tools/gdb/tarnkiln.py
    DESTINATION ${CMAKE_INSTALL_DATADIR}/tarnkiln/gdb)

# The generator of metamodels, and the description on which all others stand.
install(DIRECTORY ${PROJECT_SOURCE_DIR}/tools/metagen/ DESTINATION ${TARNKILN_METAGEN_DIR}
    PATTERN __pycache__ EXCLUDE)
install(FILES
    ${PROJECT_SOURCE_DIR}/src/tarnkiln/meta/catalogue.json
    ${PROJECT_SOURCE_DIR}/src/tarnkiln/meta/catalogue.cpp.json
    DESTINATION ${TARNKILN_METAGEN_DIR})
