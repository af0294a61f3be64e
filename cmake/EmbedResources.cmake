# Gives an executable the launcher's resources (catalogues, icons, version, manifest).
# On Windows the compiled script is linked in as an object, so they are the
# executable's own resources; elsewhere the resource image is stored in the
# executable's ELF section ".rsrc", where the program reads it at run time. Call it in
# the directory that defines the target.
if(NOT WIN32)
    find_program(VELTRONA_OBJCOPY objcopy REQUIRED)
endif()

function(veltrona_embed_resources target)
    get_property(res GLOBAL PROPERTY VELTRONA_RES_FILE)
    if(NOT res)
        message(FATAL_ERROR "veltrona_embed_resources(${target}): the resource image is not defined yet")
    endif()
    add_dependencies(${target} veltrona_res)
    if(WIN32)
        set_source_files_properties("${res}" PROPERTIES GENERATED TRUE EXTERNAL_OBJECT TRUE)
        target_sources(${target} PRIVATE "${res}")
        return()
    endif()
    # A changed resource image relinks the target, which runs the step below again.
    set_property(TARGET ${target} APPEND PROPERTY LINK_DEPENDS "${res}")
    add_custom_command(TARGET ${target} POST_BUILD
        COMMAND "${VELTRONA_OBJCOPY}" --add-section ".rsrc=${res}"
                --set-section-flags .rsrc=noload,readonly "$<TARGET_FILE:${target}>"
        VERBATIM)
endfunction()
