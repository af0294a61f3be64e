# veltrona_stage_demo(<target-or-file> <destination>) copies a built target's
# file, or a plain file, to <destination> below ${CMAKE_BINARY_DIR}/demo/ and
# makes the `demo` target (built by default) keep that copy up to date.
# It may be called from any directory of the build.

set(VELTRONA_DEMO_DIR "${CMAKE_BINARY_DIR}/demo" CACHE INTERNAL "The demo installation")

function(veltrona_stage_demo source destination)
    set(output "${VELTRONA_DEMO_DIR}/${destination}")
    get_filename_component(outputDir "${output}" DIRECTORY)
    if(TARGET "${source}")
        set(input "$<TARGET_FILE:${source}>")
        set(dependency "${source}")
    else()
        get_filename_component(input "${source}" ABSOLUTE)
        set(dependency "${input}")
    endif()

    add_custom_command(
        OUTPUT "${output}"
        COMMAND "${CMAKE_COMMAND}" -E make_directory "${outputDir}"
        COMMAND "${CMAKE_COMMAND}" -E copy "${input}" "${output}"
        DEPENDS "${dependency}"
        COMMENT "Staging demo/${destination}"
        VERBATIM)

    # Custom command outputs are only seen by targets of the same directory,
    # so every staged file gets a small target of its own under `demo`.
    string(MAKE_C_IDENTIFIER "demo_${destination}" stageTarget)
    add_custom_target(${stageTarget} DEPENDS "${output}")
    if(NOT TARGET demo)
        add_custom_target(demo ALL)
    endif()
    add_dependencies(demo ${stageTarget})
endfunction()
