# Run by CPack's External generator once every component is staged below
# CPACK_TEMPORARY_DIRECTORY: each component becomes its Windows Installer package.
include("${CMAKE_CURRENT_LIST_DIR}/BuildMsi.cmake")

set(CPACK_EXTERNAL_BUILT_PACKAGES "")
foreach(component launcher standins)
    set(msi "${CPACK_TEMPORARY_DIRECTORY}/${veltrona_msi_${component}}-${CPACK_PACKAGE_VERSION}-x64.msi")
    veltrona_build_msi(${component} "${CPACK_TEMPORARY_DIRECTORY}/${component}"
                       "${CPACK_PACKAGE_VERSION}" "${msi}" "${CPACK_VELTRONA_MSI_SETTINGS}")
    list(APPEND CPACK_EXTERNAL_BUILT_PACKAGES "${msi}")
endforeach()
