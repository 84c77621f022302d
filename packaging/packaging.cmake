# The installed program: the executable, the plug-in items where the resources rule looks for
# them (platform/resources_folder.h), the desktop entry and the icon. The Debian package and
# the macOS application bundle are made from these rules.

set(ORBELANE_PROGRAM orbelane-verification-storage)

if(APPLE)
  # X.app/Contents/MacOS/X, with the plug-in items in X.app/Contents/Resources.
  if(NOT CMAKE_OSX_DEPLOYMENT_TARGET)
    set(CMAKE_OSX_DEPLOYMENT_TARGET 12.0)  # the oldest macOS that current Qt 6 supports
  endif()
  set_target_properties(${ORBELANE_PROGRAM} PROPERTIES
    MACOSX_BUNDLE TRUE
    OUTPUT_NAME "Orbelane Verification Storage"
    MACOSX_BUNDLE_INFO_PLIST ${CMAKE_CURRENT_LIST_DIR}/Info.plist.in
    MACOSX_BUNDLE_BUNDLE_NAME "Orbelane Verification Storage"
    MACOSX_BUNDLE_GUI_IDENTIFIER com.orbelane.verification-storage
    MACOSX_BUNDLE_BUNDLE_VERSION ${PROJECT_VERSION}
    MACOSX_BUNDLE_SHORT_VERSION_STRING ${PROJECT_VERSION})
  add_custom_command(TARGET ${ORBELANE_PROGRAM} POST_BUILD
    COMMAND ${CMAKE_COMMAND} -E copy_directory ${PROJECT_SOURCE_DIR}/resources
            "$<TARGET_BUNDLE_CONTENT_DIR:${ORBELANE_PROGRAM}>/Resources")
  install(TARGETS ${ORBELANE_PROGRAM} BUNDLE DESTINATION .)
else()
  # In the build tree the plug-in items stand beside the executable, in "<executable> Resources".
  add_custom_command(TARGET ${ORBELANE_PROGRAM} POST_BUILD
    COMMAND ${CMAKE_COMMAND} -E copy_directory ${PROJECT_SOURCE_DIR}/resources
            "$<TARGET_FILE:${ORBELANE_PROGRAM}> Resources")

  # bin and share, not GNUInstallDirs' variables: the resources rule knows only this layout.
  install(TARGETS ${ORBELANE_PROGRAM} RUNTIME DESTINATION bin)
  install(DIRECTORY ${PROJECT_SOURCE_DIR}/resources/ DESTINATION share/${ORBELANE_PROGRAM}
          USE_SOURCE_PERMISSIONS)
  install(FILES ${CMAKE_CURRENT_LIST_DIR}/${ORBELANE_PROGRAM}.desktop
          DESTINATION share/applications)
  install(FILES ${CMAKE_CURRENT_LIST_DIR}/${ORBELANE_PROGRAM}.svg
          DESTINATION share/icons/hicolor/scalable/apps)
  # The window's icon (platform/runtime/installed_icon.h): the same picture, made from the SVG by
  # "rsvg-convert -w 128 -h 128", since Qt reads SVG only with a plug-in of its own.
  install(FILES ${CMAKE_CURRENT_LIST_DIR}/${ORBELANE_PROGRAM}.png
          DESTINATION share/icons/hicolor/128x128/apps)

  # cpack -G DEB: the shared-library dependencies come from dpkg-shlibdeps.
  set(CPACK_GENERATOR DEB)
  set(CPACK_PACKAGE_NAME ${ORBELANE_PROGRAM})
  set(CPACK_PACKAGE_VENDOR Orbelane)
  set(CPACK_PACKAGE_CONTACT "Orbelane <support@orbelane.invalid>"
      CACHE STRING "Maintainer of the Debian package")
  set(CPACK_PACKAGE_DESCRIPTION_SUMMARY
      "Barcode verification results viewer and verifier plug-in installer")
  set(CPACK_PACKAGE_DESCRIPTION
      "Lists the verification results that the Orbelane barcode verifier keeps in its SQLite
store, shows any one of them as a full report, and installs the verifier plug-in into
Adobe Illustrator or Adobe Acrobat.")
  set(CPACK_PACKAGING_INSTALL_PREFIX /usr)
  set(CPACK_STRIP_FILES ON)
  set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
  set(CPACK_DEBIAN_PACKAGE_SECTION graphics)
  set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS ON)
  include(CPack)
endif()
