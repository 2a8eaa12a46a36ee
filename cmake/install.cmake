# What cmake --install puts below its prefix. The program finds share/vesk from where it stands itself.
include(GNUInstallDirs)

install(TARGETS vesk DESTINATION ${CMAKE_INSTALL_BINDIR})
install(FILES resources/ice_test_lte.deviceconfig DESTINATION share/vesk)
install(DIRECTORY src/messages/ DESTINATION share/vesk/proto
  FILES_MATCHING PATTERN "*.proto"
  PATTERN codec EXCLUDE
  PATTERN registry EXCLUDE)
install(FILES resources/vesk.1 DESTINATION share/man/man1)
install(FILES ${CMAKE_BINARY_DIR}/vesk.bash DESTINATION share/bash-completion/completions RENAME vesk)
