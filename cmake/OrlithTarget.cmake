# Settings that every target of ours shares; nothing here is exported to those who link us.

# orlith_target(NAME): language level, visibility, floating-point rules and warnings.
function(orlith_target name)
    target_compile_features(${name} PUBLIC cxx_std_17)
    set_target_properties(${name} PROPERTIES
        CXX_EXTENSIONS OFF
        CXX_VISIBILITY_PRESET hidden
        VISIBILITY_INLINES_HIDDEN ON
        POSITION_INDEPENDENT_CODE ON)
    target_compile_options(${name} PRIVATE
        # Single precision is rounded after every operation: a fused multiply-add would change
        # results that are promised to the bit.
        -ffp-contract=off
        -Wall -Wextra -Wpedantic -Wshadow -Wconversion -Wdouble-promotion -Wold-style-cast
        $<$<BOOL:${ORLITH_WARNINGS_AS_ERRORS}>:-Werror>)
endfunction()
