# Installs the host libraries, their headers, the control module with the
# widget library it links, the application and the look pack, and exports the
# package OrbaneControls:
#   find_package(OrbaneControls) gives Orbane::orbanescript, Orbane::orbanesystem,
#   Orbane::orbanewidgets and OrbaneControls_MODULE, the path of the control
#   library to load.
include(CMakePackageConfigHelpers)

install(TARGETS orbanescript orbanesystem orbanewidgets EXPORT OrbaneControlsTargets
    LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR}
    RUNTIME DESTINATION ${CMAKE_INSTALL_BINDIR})
install(TARGETS orbanecontrols LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR}/orbane)
install(TARGETS orbane RUNTIME DESTINATION ${CMAKE_INSTALL_BINDIR})
install(DIRECTORY ${PROJECT_SOURCE_DIR}/hostapi/orbane DESTINATION ${CMAKE_INSTALL_INCLUDEDIR})
# The widget library's headers keep their folders: "widgets/CustomSlider.h".
install(DIRECTORY ${PROJECT_SOURCE_DIR}/controls/widgets DESTINATION ${CMAKE_INSTALL_INCLUDEDIR}/orbanecontrols
    FILES_MATCHING PATTERN "*.h")
install(FILES ${PROJECT_SOURCE_DIR}/controls/inputcontrols/CCPickButton.h
    ${PROJECT_SOURCE_DIR}/controls/inputcontrols/PickButton.h
    DESTINATION ${CMAKE_INSTALL_INCLUDEDIR}/orbanecontrols/inputcontrols)
install(DIRECTORY ${PROJECT_SOURCE_DIR}/looks/default DESTINATION ${CMAKE_INSTALL_DATADIR}/orbane/looks)

set(ORBANE_CMAKE_DIR ${CMAKE_INSTALL_LIBDIR}/cmake/OrbaneControls)
install(EXPORT OrbaneControlsTargets NAMESPACE Orbane:: DESTINATION ${ORBANE_CMAKE_DIR})
configure_package_config_file(${PROJECT_SOURCE_DIR}/cmake/OrbaneControlsConfig.cmake.in
    ${CMAKE_BINARY_DIR}/OrbaneControlsConfig.cmake
    INSTALL_DESTINATION ${ORBANE_CMAKE_DIR}
    PATH_VARS CMAKE_INSTALL_LIBDIR)
write_basic_package_version_file(${CMAKE_BINARY_DIR}/OrbaneControlsConfigVersion.cmake
    COMPATIBILITY SameMinorVersion)
install(FILES ${CMAKE_BINARY_DIR}/OrbaneControlsConfig.cmake ${CMAKE_BINARY_DIR}/OrbaneControlsConfigVersion.cmake
    DESTINATION ${ORBANE_CMAKE_DIR})
