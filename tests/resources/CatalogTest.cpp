// The embedded resources on Linux: the reader over the ELF section of the real executable
// and damaged copies, and the catalogues taken from it in every language.
#include "frame/Veltro3AppFrame.h"
#include "platform/ResourceImage.h"
#include "platform/UserLanguage.h"
#include "platform/unix/ElfResources.h"
#include "resources/CatalogFormat.h"
#include "resources/Catalogs.h"

#include <gtest/gtest.h>
#include <wx/filesys.h>
#include <wx/fs_mem.h>
#include <wx/menu.h>

#include <algorithm>
#include <cstdio>
#include <fstream>
#include <iterator>
#include <memory>
#include <set>

using Bytes = std::vector<unsigned char>;

TEST(ResourceImage, DamagedFilesAndImagesYieldOnlyWholeEntries)
{
    std::ifstream in("/proc/self/exe", std::ios::binary);
    Bytes exe(std::istreambuf_iterator<char>(in), {}), section;
    auto read = [&](std::size_t size, const char* name) {
        return ReadElfSection(MemoryByteSource(exe.data(), size), name, section);
    };
    ASSERT_TRUE(read(exe.size(), ".rsrc"));
    const ResourceImage whole(section);
    ASSERT_GT(whole.Entries().size(), 20u);
    EXPECT_NE(whole.Find(ResourceTypeRcData, "zh_cn/veltro.mo"), nullptr) << "names ignore case";
    for (std::size_t length = 0; length < section.size(); length += 1 + length / 7) {
        const Bytes cut(section.begin(), section.begin() + long(length));
        EXPECT_LT(ResourceImage(cut).Entries().size(), whole.Entries().size()) << length;
    }
    EXPECT_FALSE(read(exe.size(), ".rsrc2") || read(exe.size(), ".rsr"));
    EXPECT_FALSE(read(4096, ".rsrc")); // cut before the section headers
}

namespace {

Bytes Catalogue(const std::string& name)
{
    const ResourceEntry* entry = ResourceImage::OfExecutable().Find(ResourceTypeRcData, name);
    return entry ? Bytes(entry->data, entry->data + entry->size) : Bytes();
}

// Per menu of a new frame, its label and those of its items, in order.
std::vector<std::vector<std::string>> MenuLabels()
{
    Veltro3AppFrame* frame = new Veltro3AppFrame("Veltrona", wxDefaultPosition, wxDefaultSize);
    const wxMenuBar* bar = frame->GetMenuBar();
    std::vector<std::vector<std::string>> menus(bar->GetMenuCount());
    for (size_t i = 0; i < menus.size(); ++i) {
        menus[i].push_back(bar->GetMenuLabel(i).utf8_string());
        for (const wxMenuItem* item : bar->GetMenu(i)->GetMenuItems())
            menus[i].push_back(item->GetItemLabel().utf8_string());
    }
    frame->Destroy();
    return menus;
}

// The language, and whether a catalogue translates it.
using MenusInLanguage = testing::TestWithParam<std::pair<std::string, bool>>;

} // namespace

TEST(Catalogs, OnlyWellFormedCatalogueResourcesAreCopied)
{
    const Bytes ja = Catalogue("JA/VELTRO.MO");
    ASSERT_TRUE(IsWellFormedCatalog(ja.data(), ja.size()));
    ASSERT_FALSE(IsWellFormedCatalog(ja.data(), ja.size() - 1));
    // In a copy of the executable's resources, the Japanese catalogue's last text loses its end.
    Bytes image;
    ASSERT_TRUE(ReadElfSectionOfFile("/proc/self/exe", ".rsrc", image));
    const auto at = std::search(image.begin(), image.end(), ja.begin(), ja.end());
    ASSERT_NE(at, image.end());
    at[ja.size() - 1] = 'x';
    wxFileSystem::AddHandler(new wxMemoryFSHandler);
    LoadCatalogResources(ResourceImage(image));
    wxFileSystem fs;
    EXPECT_FALSE(std::unique_ptr<wxFSFile>(fs.OpenFile("memory:./ja/Veltro.mo")));
    EXPECT_TRUE(std::unique_ptr<wxFSFile>(fs.OpenFile("memory:./zh_CN/Veltro.mo")));
}

TEST(Catalogs, EveryCatalogueTranslatesEveryTextOfTheSources)
{
    const std::string pot = testing::TempDir() + "veltrona.pot", mo = pot + ".mo";
    const std::string extract = "cd '" VELTRONA_SOURCE_DIR "' && find wxapplauncher -name '*.cpp' "
                                "-o -name '*.h' | xgettext --from-code=UTF-8 -C -k_ "
                                "-kwxTRANSLATE -kwxGetTranslation -f - -o '" +
                                pot + "' && grep -q '^msgid \"&File\"' '" + pot + "'";
    ASSERT_EQ(std::system(extract.c_str()), 0) << "xgettext found no menu texts";
    for (const char* lang : {"DE", "EN", "ES", "FR", "IT", "JA", "NL", "PT", "ZH_CN"}) {
        const Bytes bytes = Catalogue(std::string(lang) + "/VELTRO.MO");
        std::ofstream(mo).write(reinterpret_cast<const char*>(bytes.data()), long(bytes.size()));
        const std::string compare = "msgunfmt '" + mo + "' | msgcmp - '" + pot + "'";
        EXPECT_EQ(std::system(compare.c_str()), 0) << lang << " lacks texts of the sources";
    }
    std::remove(pot.c_str());
    std::remove(mo.c_str());
}

TEST_P(MenusInLanguage, FileAndHelpMenusAreTranslatedWithALetterPerItem)
{
    const auto english = MenuLabels();
    for (const char* name : {"LANGUAGE", "LC_ALL", "LC_MESSAGES"})
        unsetenv(name);
    setenv("LANG", (GetParam().first + ".UTF-8").c_str(), 1);
    wxLocale locale;
    DecideUserLanguage();
    InitLocale(locale);
    wxFileSystem::AddHandler(new wxMemoryFSHandler);
    LoadCatalogResources();
    wxLocale::AddCatalogLookupPathPrefix("memory:.");
    locale.AddCatalog("Veltro");

    const auto shown = MenuLabels();
    ASSERT_EQ(shown.size(), english.size());
    size_t translated = 0;
    for (size_t m = 0; m < shown.size(); ++m) {
        ASSERT_EQ(shown[m].size(), english[m].size());
        std::set<wxString> letters;
        size_t items = 0;
        for (size_t i = 0; i < shown[m].size(); ++i) {
            translated += shown[m][i] != english[m][i];
            const wxString label = wxString::FromUTF8(shown[m][i]).BeforeFirst('\t');
            items += i > 0 && !label.empty();
            if (i > 0 && label.Freq('&') == 1)
                letters.insert(label.AfterFirst('&').Left(1).Lower());
        }
        EXPECT_EQ(letters.size(), items) << "a missing or shared mnemonic in " << shown[m][0];
    }
    if (GetParam().second)
        EXPECT_GE(translated, 13u);
    else
        EXPECT_EQ(shown, english);
}

// Every catalogue; ja_JP uses a two-letter one; de_XX is installed nowhere; ko_KR has none.
INSTANTIATE_TEST_SUITE_P(Languages, MenusInLanguage,
                         testing::Values(std::pair("ja_JP", true), std::pair("zh_CN", true),
                                         std::pair("de_XX", true), std::pair("ko_KR", false),
                                         std::pair("en_GB", false), std::pair("es_ES", true),
                                         std::pair("fr_FR", true), std::pair("it_IT", true),
                                         std::pair("nl_NL", true), std::pair("pt_BR", true)),
                         [](const auto& info) { return info.param.first; });
