# What `cmake --install` puts where. The library can be used with none of the rest.
include(CMakePackageConfigHelpers)

set(ORLITH_CONFIG_DIR ${CMAKE_INSTALL_LIBDIR}/cmake/Orlith)

install(TARGETS orlith_lut orlith_zlib_stream EXPORT OrlithTargets
    ARCHIVE DESTINATION ${CMAKE_INSTALL_LIBDIR})
install(EXPORT OrlithTargets NAMESPACE Orlith:: DESTINATION ${ORLITH_CONFIG_DIR})

foreach(folder lut lut/property lut/io/zlib_stream)
    file(GLOB headers ${PROJECT_SOURCE_DIR}/${folder}/*.h)
    install(FILES ${headers} DESTINATION ${CMAKE_INSTALL_INCLUDEDIR}/orlith/${folder})
endforeach()
install(FILES lut/io/LUTFileReader.h lut/io/LUTFileWriter.h lut/io/Registry.h lut/io/Remarks.h
    DESTINATION ${CMAKE_INSTALL_INCLUDEDIR}/orlith/lut/io)

configure_package_config_file(cmake/OrlithConfig.cmake.in OrlithConfig.cmake
    INSTALL_DESTINATION ${ORLITH_CONFIG_DIR})
write_basic_package_version_file(OrlithConfigVersion.cmake COMPATIBILITY SameMinorVersion)
install(FILES
    ${PROJECT_BINARY_DIR}/OrlithConfig.cmake
    ${PROJECT_BINARY_DIR}/OrlithConfigVersion.cmake
    cmake/FindVNL.cmake
    DESTINATION ${ORLITH_CONFIG_DIR})

# Finds the prefix from its own place: `cmake --install --prefix` may choose another.
file(RELATIVE_PATH ORLITH_PC_TO_PREFIX
    ${CMAKE_INSTALL_FULL_LIBDIR}/pkgconfig ${CMAKE_INSTALL_PREFIX})
string(REGEX REPLACE "/$" "" ORLITH_PC_TO_PREFIX ${ORLITH_PC_TO_PREFIX})
configure_file(cmake/orlith.pc.in orlith.pc @ONLY)
install(FILES ${PROJECT_BINARY_DIR}/orlith.pc DESTINATION ${CMAKE_INSTALL_LIBDIR}/pkgconfig)
install(FILES LICENSE DESTINATION ${CMAKE_INSTALL_DATADIR}/doc/orlith)

if(ORLITH_BUILD_HOST)
    # The program looks for its bundles in ../lib/orlith, wherever the system keeps its libraries.
    install(TARGETS orlith RUNTIME DESTINATION bin)
    install(TARGETS zefra LIBRARY DESTINATION lib NAMELINK_SKIP)
    install(TARGETS GenerateLUT LIBRARY DESTINATION lib/orlith)
    install(TARGETS orlith_openimageio LIBRARY DESTINATION lib/orlith/images)
    install(FILES docs/man/orlith.1 DESTINATION ${CMAKE_INSTALL_MANDIR}/man1)
endif()
