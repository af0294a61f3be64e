# veltrona_stage_demo(<target-or-file> <destination> [COMPONENT <component>]) copies a
# built target's file, or a plain file, to <destination> below ${CMAKE_BINARY_DIR}/demo/
# and makes the `demo` target (built by default) keep that copy up to date.
# The same file is installed to <destination> below ${VELTRONA_INSTALL_DIR}, in the
# install component given: `launcher`, or by default `standins` (the package of the
# suite's stand-ins). It may be called from any directory of the build.

set(VELTRONA_DEMO_DIR "${CMAKE_BINARY_DIR}/demo" CACHE INTERNAL "The demo installation")
# The launcher runs from its own directory, so everything beside it shares this one:
# lib/veltrona below the prefix, or on Windows the prefix itself (the suite's folder).
if(WIN32)
    set(VELTRONA_INSTALL_DIR "" CACHE INTERNAL "The installed launcher's directory")
else()
    set(VELTRONA_INSTALL_DIR "${CMAKE_INSTALL_LIBDIR}/veltrona" CACHE INTERNAL
        "The installed launcher's directory, relative to the prefix")
endif()

function(veltrona_stage_demo source destination)
    cmake_parse_arguments(PARSE_ARGV 2 stage "" "COMPONENT" "")
    if(NOT stage_COMPONENT)
        set(stage_COMPONENT standins)
    endif()

    set(output "${VELTRONA_DEMO_DIR}/${destination}")
    get_filename_component(outputDir "${output}" DIRECTORY)
    # The copy keeps its source's permissions; a library needs no execute bits.
    set(permissions USE_SOURCE_PERMISSIONS)
    if(TARGET "${source}")
        set(input "$<TARGET_FILE:${source}>")
        set(dependency "${source}")
        get_target_property(type "${source}" TYPE)
        if(type MATCHES "_LIBRARY$")
            set(permissions FILE_PERMISSIONS OWNER_READ OWNER_WRITE GROUP_READ WORLD_READ)
        endif()
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

    # Installed from the staged copy, since install(TARGETS) cannot rename and a staged
    # file may be a program made by a custom command. `cmake --install --strip` and the
    # packages strip every ELF and PE file (with the target's strip in a cross build).
    get_filename_component(name "${destination}" NAME)
    get_filename_component(subdir "${destination}" DIRECTORY)
    set(installDir "${VELTRONA_INSTALL_DIR}")
    if(installDir AND subdir)
        string(APPEND installDir "/")
    endif()
    string(APPEND installDir "${subdir}")
    list(JOIN permissions " " permissions)
    string(CONFIGURE [=[
        file(INSTALL "@output@" DESTINATION "${CMAKE_INSTALL_PREFIX}/@installDir@"
             RENAME "@name@" @permissions@)
        if(CMAKE_INSTALL_DO_STRIP)
            set(installed "$ENV{DESTDIR}${CMAKE_INSTALL_PREFIX}/@installDir@/@name@")
            file(READ "${installed}" magic LIMIT 4 HEX)
            if(magic MATCHES "^(7f454c46|4d5a)")
                execute_process(COMMAND "@CMAKE_STRIP@" "${installed}" COMMAND_ERROR_IS_FATAL ANY)
            endif()
        endif()]=] code @ONLY)
    install(CODE "${code}" COMPONENT ${stage_COMPONENT})
endfunction()
