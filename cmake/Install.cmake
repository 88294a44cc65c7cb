# What a package or "cmake --install" puts into the system's folders.

include(GNUInstallDirs)
set(data ${PROJECT_SOURCE_DIR}/data)

install(TARGETS tunestead-cli)
install(PROGRAMS ${data}/tunestead-wma.sh DESTINATION ${CMAKE_INSTALL_PREFIX}/lib/tunestead)
install(FILES ${data}/man/tunestead-cli.1 DESTINATION ${CMAKE_INSTALL_MANDIR}/man1)
if(TARGET tunestead)
  install(TARGETS tunestead)
  install(FILES ${data}/man/tunestead.1 DESTINATION ${CMAKE_INSTALL_MANDIR}/man1)
  install(FILES ${data}/tunestead.desktop DESTINATION ${CMAKE_INSTALL_DATADIR}/applications)
  install(FILES ${data}/tunestead.svg DESTINATION ${CMAKE_INSTALL_DATADIR}/icons/hicolor/scalable/apps)
  install(FILES ${data}/tunestead-mime.xml DESTINATION ${CMAKE_INSTALL_DATADIR}/mime/packages RENAME tunestead.xml)
  install(FILES ${data}/de.tunestead.Tunestead.metainfo.xml DESTINATION ${CMAKE_INSTALL_DATADIR}/metainfo)
endif()
