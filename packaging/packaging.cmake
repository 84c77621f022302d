# The installed program: the executable, the plug-in items where the resources rule looks for
# them (platform/core/resources_folder.h), the desktop entry, the icon and the AppStream entry. The
# Debian package and the macOS application bundle are made from these rules.

set(ORBELANE_PROGRAM orbelane-verification-storage)

if(APPLE)
  # X.app/Contents/MacOS/X, with the plug-in items in X.app/Contents/Resources.
  set_target_properties(${ORBELANE_PROGRAM} PROPERTIES
    MACOSX_BUNDLE TRUE
    OUTPUT_NAME "Orbelane Verification Storage"
    MACOSX_BUNDLE_INFO_PLIST ${CMAKE_CURRENT_LIST_DIR}/Info.plist.in
    MACOSX_BUNDLE_BUNDLE_NAME "Orbelane Verification Storage"
    MACOSX_BUNDLE_GUI_IDENTIFIER com.orbelane.verification-storage
    MACOSX_BUNDLE_ICON_FILE ${ORBELANE_PROGRAM}.icns
    MACOSX_BUNDLE_BUNDLE_VERSION ${PROJECT_VERSION}
    MACOSX_BUNDLE_SHORT_VERSION_STRING ${PROJECT_VERSION})
  # The Dock's icon, made from the SVG by scripts/make-icns.sh.
  target_sources(${ORBELANE_PROGRAM} PRIVATE ${CMAKE_CURRENT_LIST_DIR}/${ORBELANE_PROGRAM}.icns)
  set_source_files_properties(${CMAKE_CURRENT_LIST_DIR}/${ORBELANE_PROGRAM}.icns
                              PROPERTIES MACOSX_PACKAGE_LOCATION Resources)
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
  # Named after its AppStream id, the macOS bundle's identifier.
  install(FILES ${CMAKE_CURRENT_LIST_DIR}/com.orbelane.verification-storage.metainfo.xml
          DESTINATION share/metainfo)

  # The licence and the history, where Debian keeps them. The history is compressed without
  # name or time stamp, so that the same source gives the same package.
  execute_process(COMMAND gzip -9nc INPUT_FILE ${CMAKE_CURRENT_LIST_DIR}/changelog
                  OUTPUT_FILE ${CMAKE_CURRENT_BINARY_DIR}/changelog.gz COMMAND_ERROR_IS_FATAL ANY)
  set_property(DIRECTORY APPEND PROPERTY CMAKE_CONFIGURE_DEPENDS ${CMAKE_CURRENT_LIST_DIR}/changelog)
  install(FILES ${CMAKE_CURRENT_LIST_DIR}/copyright ${CMAKE_CURRENT_BINARY_DIR}/changelog.gz
          DESTINATION share/doc/${ORBELANE_PROGRAM})

  # cpack -G DEB: the shared-library dependencies come from dpkg-shlibdeps.
  set(CPACK_GENERATOR DEB)
  set(CPACK_PACKAGE_NAME ${ORBELANE_PROGRAM})
  set(CPACK_PACKAGE_VENDOR Orbelane)
  set(CPACK_PACKAGE_CONTACT "Orbelane <support@orbelane.invalid>"
      CACHE STRING "Maintainer of the Debian package")
  set(CPACK_PACKAGE_DESCRIPTION_SUMMARY
      "Barcode verification results viewer and verifier plug-in installer")
  # Lines of the long description stay within 80 columns in the package's control file.
  set(CPACK_PACKAGE_DESCRIPTION
      "Lists the verification results that the Orbelane barcode verifier keeps in
its SQLite store, shows any one of them as a full report, and installs the
verifier plug-in into Adobe Illustrator or Adobe Acrobat.")
  set(CPACK_PACKAGING_INSTALL_PREFIX /usr)
  set(CPACK_STRIP_FILES ON)
  set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
  set(CPACK_DEBIAN_PACKAGE_SECTION graphics)
  set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS ON)
  # Qt's SVG plug-ins draw the window's icon; nothing links them, so no dependency says so.
  set(CPACK_DEBIAN_PACKAGE_RECOMMENDS libqt6svg6)
  include(CPack)
endif()
