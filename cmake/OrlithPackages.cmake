# Debian packages by `cpack`: one for each component that is installed.

set(CPACK_GENERATOR DEB)
set(CPACK_DEB_COMPONENT_INSTALL ON)
get_cmake_property(CPACK_COMPONENTS_ALL COMPONENTS)
list(REMOVE_ITEM CPACK_COMPONENTS_ALL licence)

set(CPACK_PACKAGE_CONTACT "Orlith developers <developers@orlith.invalid>")
set(CPACK_PACKAGE_DESCRIPTION_SUMMARY "")  # each package has its own
set(CPACK_DEBIAN_PACKAGE_RELEASE 1)
set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
set(CPACK_DEBIAN_COMPRESSION_TYPE xz)
set(CPACK_DEBIAN_PACKAGE_CONTROL_STRICT_PERMISSION ON)
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS ON)
set(CPACK_STRIP_FILES ON)
set(CPACK_INSTALL_DEFAULT_DIRECTORY_PERMISSIONS
    OWNER_READ OWNER_WRITE OWNER_EXECUTE GROUP_READ GROUP_EXECUTE WORLD_READ WORLD_EXECUTE)

set(CPACK_DEBIAN_PROGRAM_PACKAGE_NAME orlith)
set(CPACK_DEBIAN_PROGRAM_PACKAGE_SECTION graphics)
set(CPACK_DEBIAN_PROGRAM_PACKAGE_SUGGESTS openimageio-tools)
set(CPACK_DEBIAN_PROGRAM_DESCRIPTION "colour look-up tables for film and video
Turns any chain of colour operators into a look-up table file: a test pattern
that holds a colour cube goes through the chain, and what comes back is the
table. Reads, converts, evaluates and compares files of these kinds as their
makers mean them: .3dl, .blut, .cms, .csp, .cub, .cube and .vf. Sends images
through them, and shows them and their faults as a page for a browser.

What is converted keeps its look, or the program says by how much it does not.")

# What the headers include, and what the static library links.
set(CPACK_DEBIAN_DEVELOPMENT_PACKAGE_NAME liborlith-dev)
set(CPACK_DEBIAN_DEVELOPMENT_PACKAGE_SOURCE orlith)
set(CPACK_DEBIAN_DEVELOPMENT_PACKAGE_SECTION libdevel)
set(CPACK_DEBIAN_DEVELOPMENT_PACKAGE_DEPENDS "libboost-dev, libhwy-dev, libimath-dev, \
libinsighttoolkit5-dev, pkg-config, zlib1g-dev")
set(CPACK_DEBIAN_DEVELOPMENT_DESCRIPTION "colour look-up tables for film and video (library)
Reads, writes and evaluates .3dl, .blut, .cms, .csp, .cub, .cube and .vf files:
curves and lattices with pre-LUTs and domains, one colour at a time or many at
once.

This package has the headers, the static library, and what CMake and
pkg-config need to find them.")

# The module is built for one version of Python.
if(ORLITH_BUILD_PYTHON)
    string(REGEX REPLACE "^3\\." "" python_minor ${PYTHON_MODULE_VERSION})
    math(EXPR python_next "${python_minor} + 1")
endif()
set(CPACK_DEBIAN_PYTHON_PACKAGE_NAME python3-orlith)
set(CPACK_DEBIAN_PYTHON_PACKAGE_SOURCE orlith)
set(CPACK_DEBIAN_PYTHON_PACKAGE_SECTION python)
set(CPACK_DEBIAN_PYTHON_PACKAGE_DEPENDS "python3 (>= 3.${python_minor}), \
python3 (<< 3.${python_next}), python3-numpy")
set(CPACK_DEBIAN_PYTHON_DESCRIPTION "colour look-up tables for film and video (Python module)
Reads, writes and compares files of these kinds, and sends NumPy arrays of
colours through them: .3dl, .blut, .cms, .csp, .cub, .cube and .vf.

The module is for the version of Python that this system comes with.")

# The documents that Debian wants of every package. The date is SOURCE_DATE_EPOCH where it is set.
string(TIMESTAMP ORLITH_PACKAGE_DATE "%a, %d %b %Y %H:%M:%S +0000" UTC)
configure_file(packaging/debian/changelog.in changelog.Debian @ONLY)
orlith_compress(${PROJECT_BINARY_DIR}/changelog.Debian changelog.Debian.gz)
orlith_compress(${PROJECT_SOURCE_DIR}/CHANGELOG.md changelog.gz)

# What is compiled in from others, by headers or as scripts of the page, brings its notice;
# libraries that are linked have packages of their own.
set(library_notices libhwy-dev libimath-dev libinsighttoolkit5-dev)
set(ORLITH_DEVELOPMENT_NOTICES ${library_notices})
set(ORLITH_PROGRAM_NOTICES
    ${library_notices} libcli11-dev libfmt-dev libjs-chart.js libjs-three nlohmann-json3-dev
    pybind11-dev)
set(ORLITH_PYTHON_NOTICES ${library_notices} pybind11-dev)

foreach(component ${CPACK_COMPONENTS_ALL})
    string(TOUPPER ${component} COMPONENT)
    set(folder share/doc/${CPACK_DEBIAN_${COMPONENT}_PACKAGE_NAME})
    install(FILES
        packaging/debian/copyright
        ${PROJECT_BINARY_DIR}/changelog.Debian.gz
        ${PROJECT_BINARY_DIR}/changelog.gz
        DESTINATION ${folder} COMPONENT ${component} EXCLUDE_FROM_ALL)
    foreach(package ${ORLITH_${COMPONENT}_NOTICES})
        install(FILES /usr/share/doc/${package}/copyright RENAME ${package}
            DESTINATION ${folder}/notices COMPONENT ${component} EXCLUDE_FROM_ALL)
    endforeach()
endforeach()

include(CPack)
