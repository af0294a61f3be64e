# veltrona_build_msi(<package> <staged> <version> <output> <settings>) makes the Windows
# Installer package <output> of one staged install component (`launcher` or `standins`):
# <package>.wxs beside this file, with every file of the folder <staged> installed to the
# same path below the suite's folder, and the settings file that the build writes.
# As a script: cmake -DPACKAGE=... -DSTAGED=... -DVERSION=... -DOUTPUT=... -DSETTINGS=...
#              -P BuildMsi.cmake
cmake_policy(VERSION 3.18)

# The packages' file names.
set(veltrona_msi_launcher Veltrona)
set(veltrona_msi_standins Veltrona-suite-standins)

# Installer identifiers: letters, digits, "_" and "."; at most 72 characters.
function(veltrona_msi_id prefix path out)
    string(MAKE_C_IDENTIFIER "${path}" id)
    string(LENGTH "${prefix}${id}" length)
    if(length GREATER 72)
        string(MD5 id "${path}")
    endif()
    set(${out} "${prefix}${id}" PARENT_SCOPE)
endfunction()

# Appends the elements of the staged folder <dir> (relative to the staged root) to the
# fragment, each file a component of its own whose key is the file.
function(veltrona_msi_walk staged dir indent)
    set(here "${staged}")
    if(dir)
        string(APPEND here "/${dir}")
    endif()
    file(GLOB entries LIST_DIRECTORIES true RELATIVE "${here}" "${here}/*")
    list(SORT entries)
    foreach(name ${entries})
        set(path "${name}")
        if(dir)
            set(path "${dir}/${name}")
        endif()
        string(REPLACE "&" "&amp;" xmlName "${name}")
        if(IS_DIRECTORY "${staged}/${path}")
            veltrona_msi_id(d_ "${path}" id)
            set_property(GLOBAL APPEND_STRING PROPERTY veltrona_msi_tree
                "${indent}<Directory Id=\"${id}\" Name=\"${xmlName}\">\n")
            veltrona_msi_walk("${staged}" "${path}" "${indent}  ")
            set_property(GLOBAL APPEND_STRING PROPERTY veltrona_msi_tree "${indent}</Directory>\n")
        else()
            veltrona_msi_id(f_ "${path}" id)
            get_property(ids GLOBAL PROPERTY veltrona_msi_files)
            if(id IN_LIST ids)
                message(FATAL_ERROR "Two staged files make the same installer name ${id}")
            endif()
            string(REPLACE "&" "&amp;" source "staged/${path}")
            set_property(GLOBAL APPEND_STRING PROPERTY veltrona_msi_tree
                "${indent}<Component Id=\"c${id}\" Guid=\"*\" Win64=\"yes\">\n"
                "${indent}  <File Id=\"${id}\" Name=\"${xmlName}\" Source=\"${source}\" KeyPath=\"yes\"/>\n"
                "${indent}</Component>\n")
            set_property(GLOBAL APPEND PROPERTY veltrona_msi_files "${id}")
            set_property(GLOBAL APPEND PROPERTY veltrona_msi_paths "${path}")
        endif()
    endforeach()
endfunction()

function(veltrona_build_msi package staged version output settings)
    include("${settings}")
    set(work "${output}.work")
    file(REMOVE_RECURSE "${work}")
    file(MAKE_DIRECTORY "${work}")
    # wixl takes sources relative to where it runs.
    file(CREATE_LINK "${staged}" "${work}/staged" SYMBOLIC)
    configure_file("${icon}" "${work}/Veltrona.ico" COPYONLY)

    set_property(GLOBAL PROPERTY veltrona_msi_tree "")
    set_property(GLOBAL PROPERTY veltrona_msi_files "")
    set_property(GLOBAL PROPERTY veltrona_msi_paths "")
    veltrona_msi_walk("${staged}" "" "      ")
    get_property(tree GLOBAL PROPERTY veltrona_msi_tree)
    get_property(ids GLOBAL PROPERTY veltrona_msi_files)
    get_property(paths GLOBAL PROPERTY veltrona_msi_paths)
    set(refs "")
    foreach(id ${ids})
        string(APPEND refs "      <ComponentRef Id=\"c${id}\"/>\n")
    endforeach()
    file(WRITE "${work}/files.wxs" "<?xml version=\"1.0\" encoding=\"utf-8\"?>
<Wix xmlns=\"http://schemas.microsoft.com/wix/2006/wi\">
  <Fragment>
    <DirectoryRef Id=\"INSTALLDIR\">
${tree}    </DirectoryRef>
  </Fragment>
  <Fragment>
    <ComponentGroup Id=\"StagedFiles\">
${refs}    </ComponentGroup>
  </Fragment>
</Wix>
")

    execute_process(
        COMMAND "${wixl}" -a x64 -D "Version=${version}" -D "HelpLink=${helpLink}"
                -D "SupportLink=${supportLink}" -o "${output}" "${sources}/${package}.wxs"
                files.wxs
        WORKING_DIRECTORY "${work}"
        RESULT_VARIABLE failed)
    if(failed)
        message(FATAL_ERROR "wixl could not make ${output}")
    endif()

    # wixl records no file versions: each program's version resource gives its own, and
    # a file with a version has no hash (repair and upgrade compare the versions).
    set(queries "")
    foreach(id path IN ZIP_LISTS ids paths)
        if(NOT path MATCHES "\\.(exe|dll)$")
            continue()
        endif()
        execute_process(COMMAND "${windres}" -J coff -O rc -i "${staged}/${path}"
                        OUTPUT_VARIABLE resources ERROR_QUIET RESULT_VARIABLE noResources)
        if(NOT noResources AND resources MATCHES
                "\n *FILEVERSION ([0-9]+), *([0-9]+), *([0-9]+), *([0-9]+)")
            set(fileVersion "${CMAKE_MATCH_1}.${CMAKE_MATCH_2}.${CMAKE_MATCH_3}.${CMAKE_MATCH_4}")
            list(APPEND queries "UPDATE `File` SET `Version` = '${fileVersion}' WHERE `File` = '${id}'"
                                "DELETE FROM `MsiFileHash` WHERE `File_` = '${id}'")
        endif()
    endforeach()
    # wixl writes no component conditions: the desktop shortcut is there when asked for,
    # and the removal takes it away whatever the command line says (a component whose
    # condition is false keeps its state).
    if(package STREQUAL "launcher")
        list(APPEND queries "UPDATE `Component` SET `Condition` = 'DESKTOPSHORTCUT=1 OR REMOVE~=\"ALL\"' WHERE `Component` = 'DesktopShortcut'")
    endif()
    foreach(query ${queries})
        execute_process(COMMAND "${msibuild}" "${output}" -q "${query}" RESULT_VARIABLE failed)
        if(failed)
            message(FATAL_ERROR "msibuild could not run on ${output}: ${query}")
        endif()
    endforeach()
    file(REMOVE_RECURSE "${work}")
endfunction()

if(CMAKE_SCRIPT_MODE_FILE STREQUAL CMAKE_CURRENT_LIST_FILE)
    veltrona_build_msi("${PACKAGE}" "${STAGED}" "${VERSION}" "${OUTPUT}" "${SETTINGS}")
endif()
