# Finds VXL's numerics library (vnl), stand-alone or as the copy inside an installed ITK.
# Defines the imported target VNL::VNL.

find_path(VNL_INCLUDE_DIR vnl/vnl_vector_fixed.h
    PATH_SUFFIXES ITK-5.4 ITK-5.3 ITK-5.2 ITK-5.1 ITK-5.0 vxl/core vxl)
find_path(VNL_VCL_INCLUDE_DIR vcl_compiler.h
    HINTS ${VNL_INCLUDE_DIR} ${VNL_INCLUDE_DIR}/../vcl
    PATH_SUFFIXES vxl/vcl)
find_library(VNL_LIBRARY
    NAMES itkvnl-5.4 itkvnl-5.3 itkvnl-5.2 itkvnl-5.1 itkvnl-5.0 itkvnl vnl)

include(FindPackageHandleStandardArgs)
find_package_handle_standard_args(VNL
    REQUIRED_VARS VNL_LIBRARY VNL_INCLUDE_DIR VNL_VCL_INCLUDE_DIR)
mark_as_advanced(VNL_INCLUDE_DIR VNL_VCL_INCLUDE_DIR VNL_LIBRARY)

if(VNL_FOUND AND NOT TARGET VNL::VNL)
    add_library(VNL::VNL UNKNOWN IMPORTED)
    set_target_properties(VNL::VNL PROPERTIES
        IMPORTED_LOCATION "${VNL_LIBRARY}"
        INTERFACE_INCLUDE_DIRECTORIES "${VNL_INCLUDE_DIR};${VNL_VCL_INCLUDE_DIR}")
endif()
