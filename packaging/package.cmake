# The package of Debian and the tarball.
set(CPACK_PACKAGE_NAME kora-charting)
set(CPACK_PACKAGE_VERSION ${KORA_VERSION})
set(CPACK_PACKAGE_VENDOR "KORA Charting")
set(CPACK_PACKAGE_DESCRIPTION_SUMMARY "Draw and scan charts of daily share prices")
set(CPACK_PACKAGE_DESCRIPTION
"KORA Charting keeps the daily prices of shares, indices and other securities
in plain files and draws them as bar, candlestick, line, and point and figure
charts with averages, bands, trendlines and a family of oscillators. It takes
in the daily files of a data service, scans the market and prints. The command
koractl does the same from a shell.")
set(KORA_CONTACT "KORA Charting <kora@koracharting.org>" CACHE STRING "Who a package names as its maintainer")
set(CPACK_PACKAGE_CONTACT ${KORA_CONTACT})
set(CPACK_GENERATOR DEB TGZ)
set(CPACK_STRIP_FILES ON)
set(CPACK_INSTALL_DEFAULT_DIRECTORY_PERMISSIONS
  OWNER_READ OWNER_WRITE OWNER_EXECUTE GROUP_READ GROUP_EXECUTE WORLD_READ WORLD_EXECUTE)
set(CPACK_VERBATIM_VARIABLES ON)
set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS ON)
set(CPACK_DEBIAN_PACKAGE_SECTION misc)
set(CPACK_DEBIAN_PACKAGE_PRIORITY optional)
set(CPACK_DEBIAN_PACKAGE_RECOMMENDS fonts-liberation)
set(CPACK_PROJECT_CONFIG_FILE ${CMAKE_CURRENT_SOURCE_DIR}/package_place.cmake)
set(CPACK_PRE_BUILD_SCRIPTS ${CMAKE_CURRENT_SOURCE_DIR}/package_debian.cmake)
set(CPACK_KORA_COPYRIGHT ${CMAKE_CURRENT_SOURCE_DIR}/copyright)
include(CPack)
