// The real Veltrona.exe's resources as Windows itself reads them: the nine catalogues,
// the icon group "IDI_ICON1" and the version; and the launcher's own readers over the
// same calls (the test program carries the same resources), and the modules' versions.
#include "about/ModuleInfo.h"
#include "about/VersionInfo.h"
#include "platform/ResourceImage.h"
#include "resources/CatalogFormat.h"
#include "support/StandinDir.h"

#include <gtest/gtest.h>
#include <wx/filefn.h>

#include <windows.h>

#include <cstdint>
#include <cstring>
#include <set>
#include <string>

namespace {

std::pair<const unsigned char*, DWORD> Resource(HMODULE module, const wchar_t* name,
                                                const wchar_t* type)
{
    const HRSRC found = FindResourceW(module, name, type);
    if (!found)
        return {nullptr, 0};
    return {static_cast<const unsigned char*>(LockResource(LoadResource(module, found))),
            SizeofResource(module, found)};
}

TEST(ExecutableResourceTest, CataloguesIconGroupAndVersionThroughTheSystem)
{
    const std::wstring launcher = wxString(VELTRONA_LAUNCHER_PATH).ToStdWstring();
    const HMODULE module = LoadLibraryExW(launcher.c_str(), nullptr, LOAD_LIBRARY_AS_DATAFILE);
    ASSERT_NE(module, nullptr);

    std::set<std::wstring> names;
    EnumResourceNamesW(
        module, MAKEINTRESOURCEW(10), // RT_RCDATA
        [](HMODULE, LPCWSTR, LPWSTR name, LONG_PTR found) -> BOOL {
            if (!IS_INTRESOURCE(name))
                reinterpret_cast<std::set<std::wstring>*>(found)->insert(name);
            return TRUE;
        },
        reinterpret_cast<LONG_PTR>(&names));
    const std::set<std::wstring> catalogues = {
        L"DE/VELTRO.MO", L"EN/VELTRO.MO", L"ES/VELTRO.MO", L"FR/VELTRO.MO",   L"IT/VELTRO.MO",
        L"JA/VELTRO.MO", L"NL/VELTRO.MO", L"PT/VELTRO.MO", L"ZH_CN/VELTRO.MO"};
    EXPECT_EQ(names, catalogues);
    for (const std::wstring& name : catalogues) {
        const auto [data, size] = Resource(module, name.c_str(), MAKEINTRESOURCEW(10));
        EXPECT_TRUE(data && IsWellFormedCatalog(data, size)) << wxString(name);
    }

    // The group: a header of three WORDs, then 14-byte entries naming the RT_ICON images.
    const auto [group, groupSize] = Resource(module, L"IDI_ICON1", MAKEINTRESOURCEW(14));
    ASSERT_TRUE(group && groupSize >= 6);
    const unsigned count = group[4] | group[5] << 8;
    ASSERT_EQ(groupSize, 6 + 14 * count);
    std::set<int> trueColour;
    for (unsigned i = 0; i < count; ++i) {
        const unsigned char* entry = group + 6 + 14 * i;
        std::uint32_t bytes;
        std::memcpy(&bytes, entry + 8, 4);
        const WORD id = entry[12] | entry[13] << 8;
        EXPECT_EQ(Resource(module, MAKEINTRESOURCEW(id), MAKEINTRESOURCEW(3)).second, bytes) << id;
        if ((entry[6] | entry[7] << 8) == 32)
            trueColour.insert(entry[0] ? entry[0] : 256);
    }
    EXPECT_EQ(trueColour, (std::set<int>{16, 32, 48, 64, 72, 80, 96, 128, 256}));
    FreeLibrary(module);

    DWORD ignored = 0;
    std::string block(GetFileVersionInfoSizeW(launcher.c_str(), &ignored), '\0');
    ASSERT_FALSE(block.empty());
    ASSERT_TRUE(GetFileVersionInfoW(launcher.c_str(), 0, DWORD(block.size()), block.data()));
    VS_FIXEDFILEINFO* fixed = nullptr;
    UINT length = 0;
    ASSERT_TRUE(VerQueryValueW(block.data(), L"\\", reinterpret_cast<void**>(&fixed), &length));
    EXPECT_EQ(std::make_pair(fixed->dwProductVersionMS, fixed->dwProductVersionLS),
              std::make_pair(DWORD(3 << 16 | 1), DWORD(2 << 16 | 1)));
    EXPECT_EQ(VersionInfo(VELTRONA_LAUNCHER_PATH).FormatVersion(), "3.1.2.01");
    EXPECT_EQ(GetLauncherVersion(), "3.1.2.01");
    EXPECT_NE(ResourceImage::OfExecutable().Find(ResourceTypeRcData, "zh_cn/veltro.mo"), nullptr)
        << "names ignore case";
}

// About Modules reads each module's product version through the version API.
TEST(ExecutableResourceTest, ModuleVersionsThroughTheSystem)
{
    StandinDir install({"Quenta Print Studio.exe", "Monitor\\Zel Display Studio.exe"});
    wxSetWorkingDirectory(install.Path());
    const wxArrayString print = ModuleInfoLines(1025), monitor = ModuleInfoLines(1026),
                        verify = ModuleInfoLines(1030);
    ASSERT_TRUE(print.size() == 7 && monitor.size() == 7 && verify.size() == 7);
    EXPECT_EQ(print[2] + "|" + print[3], "Quenta Print Studio|Version 3.1.0.07");
    EXPECT_EQ(monitor[2] + "|" + monitor[3], "Zel Display Studio|Version 3.1.0.07");
    EXPECT_EQ(verify[2] + "|" + verify[3], "Zel Verify Studio|Version N/A") << "not installed";
}

} // namespace
