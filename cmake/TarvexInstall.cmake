# What `cmake --install` puts where, so that hosts build outside of this tree with find_package(Tarvex).
include(GNUInstallDirs)
include(CMakePackageConfigHelpers)

set(package_dir "${CMAKE_INSTALL_LIBDIR}/cmake/Tarvex")
set(header_dir "${CMAKE_INSTALL_INCLUDEDIR}/tarvex")

set(exported_targets TarvexPlatform TarvexMain GuiUtilities tvx-rc tvx-includes)
install(TARGETS ${exported_targets} EXPORT TarvexTargets
  RUNTIME DESTINATION "${CMAKE_INSTALL_BINDIR}"
  LIBRARY DESTINATION "${CMAKE_INSTALL_LIBDIR}"
  ARCHIVE DESTINATION "${CMAKE_INSTALL_LIBDIR}")
# Loaded by name from there: nobody links it.
install(TARGETS TarvexTheme TarvexCommonControls LIBRARY DESTINATION "${CMAKE_INSTALL_LIBDIR}/tarvex")
install(TARGETS tvxsettings tvxopen helpmapcheck RUNTIME DESTINATION "${CMAKE_INSTALL_BINDIR}")
# Builds all of that, for builds that make less than everything.
add_custom_target(installed DEPENDS ${exported_targets} TarvexTheme TarvexCommonControls tvxsettings tvxopen helpmapcheck)
install(FILES tools/settings/tvxsettings.1 tools/open/tvxopen.1 tools/helpmapcheck/helpmapcheck.1
  DESTINATION "${CMAKE_INSTALL_MANDIR}/man1")

# Headers keep their paths: sources name them "s/WinApp.h", "platform/win/Registry.h", or by the umbrella headers' names.
install(DIRECTORY s DESTINATION "${header_dir}" FILES_MATCHING PATTERN "*.h")
install(DIRECTORY platform DESTINATION "${header_dir}"
  FILES_MATCHING PATTERN "*.h" PATTERN "*.rc" PATTERN "detail" EXCLUDE PATTERN "deu" EXCLUDE PATTERN "jpn" EXCLUDE)
install(FILES res/resource.h DESTINATION "${header_dir}/res")

# Translations are looked for beside the libraries.
foreach(language DEU JPN)
  install(FILES "${CMAKE_LIBRARY_OUTPUT_DIRECTORY}/TarvexPlatform.${language}"
                "${CMAKE_LIBRARY_OUTPUT_DIRECTORY}/GuiUtilities.${language}"
    DESTINATION "${CMAKE_INSTALL_LIBDIR}")
endforeach()

install(EXPORT TarvexTargets NAMESPACE Tarvex:: DESTINATION "${package_dir}")
configure_package_config_file(cmake/TarvexConfig.cmake.in "${PROJECT_BINARY_DIR}/TarvexConfig.cmake"
  INSTALL_DESTINATION "${package_dir}")
write_basic_package_version_file("${PROJECT_BINARY_DIR}/TarvexConfigVersion.cmake" COMPATIBILITY SameMajorVersion)
install(FILES
  "${PROJECT_BINARY_DIR}/TarvexConfig.cmake"
  "${PROJECT_BINARY_DIR}/TarvexConfigVersion.cmake"
  cmake/TarvexHost.cmake cmake/ResourceModule.cpp.in cmake/ResourceReference.cpp.in
  DESTINATION "${package_dir}")
