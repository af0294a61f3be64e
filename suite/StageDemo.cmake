# veltrona_stage_demo(<target-or-file> <destination> [COMPONENT <component>]) copies a
# built target's file, or a plain file, to <destination> below ${CMAKE_BINARY_DIR}/demo/
# and makes the `demo` target (built by default) keep that copy up to date.
# The same file is installed to <destination> below ${VELTRONA_INSTALL_DIR}, in the
# install component given: `launcher`, or by default `standins` (the package of the
# suite's stand-ins). It may be called from any directory of the build.

set(VELTRONA_DEMO_DIR "${CMAKE_BINARY_DIR}/demo" CACHE INTERNAL "The demo installation")
# The launcher runs from its own directory, so everything beside it shares this one.
set(VELTRONA_INSTALL_DIR "${CMAKE_INSTALL_LIBDIR}/veltrona" CACHE INTERNAL
    "The installed launcher's directory, relative to the prefix")

function(veltrona_stage_demo source destination)
    cmake_parse_arguments(PARSE_ARGV 2 stage "" "COMPONENT" "")
    if(NOT stage_COMPONENT)
        set(stage_COMPONENT standins)
    endif()

    set(output "${VELTRONA_DEMO_DIR}/${destination}")
    get_filename_component(outputDir "${output}" DIRECTORY)
    set(installKind FILES)
    set(binary FALSE)
    if(TARGET "${source}")
        set(input "$<TARGET_FILE:${source}>")
        set(dependency "${source}")
        get_target_property(type "${source}" TYPE)
        if(type STREQUAL "EXECUTABLE")
            set(installKind PROGRAMS)
        endif()
        set(binary TRUE)
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

    # install(TARGETS) cannot rename, so the staged copy is installed under its name;
    # `cmake --install --strip` and the packages then strip it here.
    get_filename_component(name "${destination}" NAME)
    get_filename_component(subdir "${destination}" DIRECTORY)
    set(installDir "${VELTRONA_INSTALL_DIR}")
    if(subdir)
        string(APPEND installDir "/${subdir}")
    endif()
    install(${installKind} "${output}" DESTINATION "${installDir}" RENAME "${name}"
            COMPONENT ${stage_COMPONENT})
    if(binary)
        install(CODE "if(CMAKE_INSTALL_DO_STRIP)
                execute_process(COMMAND \"${CMAKE_STRIP}\"
                    \"\$ENV{DESTDIR}\${CMAKE_INSTALL_PREFIX}/${installDir}/${name}\"
                    COMMAND_ERROR_IS_FATAL ANY)
            endif()"
            COMPONENT ${stage_COMPONENT})
    endif()
endfunction()
