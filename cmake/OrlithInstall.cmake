# What `cmake --install` puts where, as components: the library for those who build with it, and the
# program. The library can be used with none of the rest.
include(CMakePackageConfigHelpers)

set(CMAKE_INSTALL_DEFAULT_COMPONENT_NAME development)
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
# Of no package: Debian's have a copyright file instead.
install(FILES LICENSE DESTINATION ${CMAKE_INSTALL_DATADIR}/doc/orlith COMPONENT licence)

# orlith_compress(SOURCE NAME): as manuals and changelogs are kept, without a time stamp.
function(orlith_compress source name)
    add_custom_command(OUTPUT ${name} COMMAND gzip -9nc ${source} > ${name}
        DEPENDS ${source} VERBATIM)
    add_custom_target(compressed_${name} ALL DEPENDS ${name})
endfunction()

if(ORLITH_BUILD_HOST)
    set(CMAKE_INSTALL_DEFAULT_COMPONENT_NAME program)
    # What the program loads stands in a folder of its own: nobody else links with it.
    install(TARGETS orlith RUNTIME DESTINATION bin)
    install(TARGETS zefra LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR}/orlith NAMELINK_SKIP)
    install(TARGETS GenerateLUT LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR}/orlith)
    install(TARGETS orlith_openimageio LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR}/orlith/images)

    orlith_compress(${PROJECT_SOURCE_DIR}/docs/man/orlith.1 orlith.1.gz)
    install(FILES ${PROJECT_BINARY_DIR}/orlith.1.gz DESTINATION ${CMAKE_INSTALL_MANDIR}/man1)

    # Debian's packages have another place for zsh than what an administrator installs.
    set(ORLITH_ZSH_DIR share/zsh/site-functions CACHE STRING "Folder of the completion for zsh")
    install(FILES packaging/completion/orlith.bash RENAME orlith
        DESTINATION share/bash-completion/completions)
    install(FILES packaging/completion/_orlith DESTINATION ${ORLITH_ZSH_DIR})
endif()
