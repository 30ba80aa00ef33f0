# The target `uninstall`: takes away what the last installation from this build folder put down, and the folders that it made for
# that, as far as nothing else lies in them. Included before anything is installed.
set(folders "${CMAKE_INSTALL_BINDIR}")
foreach(folder applications dbus-1/services icons/hicolor/scalable/apps bash-completion/completions zsh/site-functions
               fish/vendor_completions.d)
  list(APPEND folders "${CMAKE_INSTALL_DATADIR}/${folder}")
endforeach()
# Below these every folder is the program's own.
set(own_folders share/orvo-transit-widget lib/orvo-transit-widget)

install(CODE "
  set(folders \"${folders};${own_folders}\")
  set(desktop_cache \"${CMAKE_INSTALL_DATADIR}/applications/mimeinfo.cache\")
  set(record \"${PROJECT_BINARY_DIR}/install_folders.cmake\")
  include(\"${PROJECT_SOURCE_DIR}/cmake/note_install_folders.cmake\")")
unset(folders)

add_custom_target(uninstall
  COMMAND ${CMAKE_COMMAND} -DBUILD=${PROJECT_BINARY_DIR} -P ${PROJECT_SOURCE_DIR}/cmake/uninstall.cmake
  COMMENT "Taking away what was installed" VERBATIM USES_TERMINAL)
