// Catalogue resources: their memory names, what start-up copies, damaged catalogues,
// and that every catalogue holds every text the launcher translates.
#include "platform/ResourceImage.h"
#include "resources/CatalogFormat.h"
#include "resources/Catalogs.h"
#include "resources/ResourceTestKit.h"

#include <gtest/gtest.h>
#include <wx/filesys.h>
#include <wx/fs_mem.h>
#include <wx/log.h>

#include <cstdio>
#include <memory>
#include <set>
#include <sstream>

namespace {

const char* const languages[] = {"DE", "EN", "ES", "FR", "IT", "JA", "NL", "PT", "ZH_CN"};

bool MemoryFileExists(const wxString& name)
{
    wxFileSystem fs;
    return std::unique_ptr<wxFSFile>(fs.OpenFile("memory:" + name)) != nullptr;
}

void UseMemoryFileSystem()
{
    static bool added = false;
    if (!added)
        wxFileSystem::AddHandler(new wxMemoryFSHandler);
    added = true;
}

// The msgids that xgettext finds in the launcher's sources.
std::set<std::string> TranslatedTextsOfSources()
{
    const std::string pot = testing::TempDir() + "veltrona-sources.pot";
    const std::string command = std::string("cd '") + VELTRONA_SOURCE_DIR +
                                "' && find wxapplauncher -name '*.cpp' -o -name '*.h' | sort | "
                                "xgettext --from-code=UTF-8 --language=C++ --keyword=_ "
                                "--keyword=wxTRANSLATE --keyword=wxGetTranslation "
                                "--omit-header -f - -o '" +
                                pot + "'";
    EXPECT_EQ(std::system(command.c_str()), 0) << command;
    const std::string mo = pot + ".mo";
    // msgfmt turns the extracted escapes into the bytes a catalogue keys on.
    const std::string compile = "msgen '" + pot + "' | msgfmt -o '" + mo + "' -";
    std::set<std::string> keys;
    if (std::system(compile.c_str()) != 0)
        return keys;
    const std::vector<unsigned char> bytes = ReadWholeFile(mo);
    for (const auto& entry : ReadCatalog(bytes.data(), bytes.size()))
        keys.insert(entry.first);
    std::remove(pot.c_str());
    std::remove(mo.c_str());
    return keys;
}

} // namespace

TEST(Catalogs, MemoryNamesFollowTheLanguageFolderRules)
{
    const std::pair<const char*, const char*> cases[] = {
        {"DE/VELTRO.MO", "./de/Veltro.mo"},
        {"ZH_CN/VELTRO.MO", "./zh_CN/Veltro.mo"},
        {"PT_BR/VELTRO.MO", "./pt_BR/Veltro.mo"},
        {"JA/SUB/VELTRO.MO", "./ja/SUB/Veltro.mo"},
        {"DE/OTHER.MO", ""},
        {"DE/VELTRO.MOVELTRO.MO", ""},
        {"/VELTRO.MO", ""},
        {"VELTRO.MO", ""},
        {"DE/veltro.mo", ""},
        {"_X/VELTRO.MO", "./_x/Veltro.mo"},
    };
    for (const auto& c : cases)
        EXPECT_EQ(CatalogMemoryName(c.first), wxString(c.second)) << c.first;
}

TEST(Catalogs, StartupCopiesTheNineCataloguesUnderLanguageFolders)
{
    UseMemoryFileSystem();
    LoadCatalogResources();
    for (const char* lang : {"de", "en", "es", "fr", "it", "ja", "nl", "pt", "zh_CN"})
        EXPECT_TRUE(MemoryFileExists(wxString("./") + lang + "/Veltro.mo")) << lang;
    EXPECT_FALSE(MemoryFileExists("./ZH_CN/Veltro.mo"));
    EXPECT_FALSE(MemoryFileExists("./zh/Veltro.mo"));
}

TEST(Catalogs, MisnamedMissingOrDamagedResourcesAreNotCopied)
{
    UseMemoryFileSystem();
    const std::vector<unsigned char> good = EmbeddedCatalog("DE/VELTRO.MO");
    ASSERT_FALSE(good.empty());
    std::vector<unsigned char> damaged = good;
    damaged[12] = 0xF0; // the table of originals now lies far outside
    const std::vector<unsigned char> cut(good.begin(), good.begin() + long(good.size() / 2));
    ResBuilder res;
    res.Add(ResourceTypeRcData, "KA/OTHER.MO", good)
        .Add(ResourceTypeRcData, "KB/VELTRO.MOVELTRO.MO", good)
        .Add(ResourceTypeRcData, "/VELTRO.MO", good)
        .Add(ResourceTypeRcData, "KC/VELTRO.MO", damaged)
        .Add(ResourceTypeRcData, "KD/VELTRO.MO", cut)
        .Add(ResourceTypeIcon, "KE/VELTRO.MO", good)
        .Add(ResourceTypeRcData, "KF_XY/VELTRO.MO", good);
    const ResourceImage image(res.Bytes());
    LoadCatalogResources(image);
    EXPECT_TRUE(MemoryFileExists("./kf_XY/Veltro.mo"));
    for (const char* name : {"./ka/OTHER.MO", "./kb/Veltro.moVeltro.mo", "./kb/Veltro.moVELTRO.MO",
                             ".//Veltro.mo", "./kc/Veltro.mo", "./kd/Veltro.mo", "./ke/Veltro.mo"})
        EXPECT_FALSE(MemoryFileExists(name)) << name;
    EXPECT_TRUE(LoadCatalogResource(image, "NOT/THERE.MO"));
    EXPECT_TRUE(LoadCatalogResource(image, "NO/VELTRO.MO"));
    EXPECT_FALSE(MemoryFileExists("./no/Veltro.mo"));
}

TEST(Catalogs, FormatCheckRejectsEveryTruncationAndStrayOffset)
{
    const std::vector<unsigned char> mo = EmbeddedCatalog("JA/VELTRO.MO");
    ASSERT_TRUE(IsWellFormedCatalog(mo.data(), mo.size()));
    for (std::size_t length = 0; length < mo.size(); ++length)
        ASSERT_FALSE(IsWellFormedCatalog(mo.data(), length)) << length;
    // A string offset past the end, and a string that loses its terminator.
    std::vector<unsigned char> stray = mo;
    const std::size_t translations = stray[16] | stray[17] << 8;
    stray[translations + 7] = 0x7F;
    EXPECT_FALSE(IsWellFormedCatalog(stray.data(), stray.size()));
    std::vector<unsigned char> unterminated = mo;
    unterminated.back() = 'x';
    EXPECT_FALSE(IsWellFormedCatalog(unterminated.data(), unterminated.size()));
    EXPECT_FALSE(IsWellFormedCatalog(nullptr, 0));
}

TEST(Catalogs, EveryCatalogueTranslatesEveryTextOfTheSources)
{
    const std::set<std::string> keys = TranslatedTextsOfSources();
    ASSERT_FALSE(keys.empty());
    ASSERT_TRUE(keys.count("&File")) << "xgettext found no menu texts";
    for (const char* lang : languages) {
        const std::vector<unsigned char> mo = EmbeddedCatalog(std::string(lang) + "/VELTRO.MO");
        const auto texts = ReadCatalog(mo.data(), mo.size());
        for (const std::string& key : keys) {
            const auto found = texts.find(key);
            EXPECT_TRUE(found != texts.end() && !found->second.empty())
                << lang << " lacks \"" << key << "\"";
        }
    }
}

TEST(Catalogs, EnglishMapsKeysToThemselvesAndOthersHoldTheSameKeys)
{
    const std::vector<unsigned char> en = EmbeddedCatalog("EN/VELTRO.MO");
    const auto english = ReadCatalog(en.data(), en.size());
    ASSERT_GT(english.size(), 40u);
    std::set<std::string> keys;
    for (const auto& entry : english) {
        EXPECT_EQ(entry.first, entry.second);
        keys.insert(entry.first);
    }
    for (const char* lang : languages) {
        const std::vector<unsigned char> mo = EmbeddedCatalog(std::string(lang) + "/VELTRO.MO");
        std::set<std::string> other;
        for (const auto& entry : ReadCatalog(mo.data(), mo.size()))
            other.insert(entry.first);
        EXPECT_EQ(other, keys) << lang;
    }
}
