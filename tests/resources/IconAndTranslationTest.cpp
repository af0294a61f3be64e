// The window icons from the icon group, and the frame's menus in every catalogue language.
#include "frame/Veltro3AppFrame.h"
#include "platform/ResourceImage.h"
#include "resources/IconBundle.h"
#include "resources/ResourceTestKit.h"

#include <gtest/gtest.h>
#include <wx/menu.h>

#include <set>

namespace {

std::set<int> Sizes(const wxIconBundle& bundle)
{
    std::set<int> sizes;
    for (size_t i = 0; i < bundle.GetIconCount(); ++i) {
        const wxIcon icon = bundle.GetIconByIndex(i);
        EXPECT_EQ(icon.GetWidth(), icon.GetHeight());
        sizes.insert(icon.GetWidth());
    }
    return sizes;
}

struct Language
{
    const char* lang;    // LANG
    const char* catalog; // resource expected to translate, or null for English
};

class MenusInLanguage : public testing::TestWithParam<Language>
{
};

// Every File and Help menu text of the frame, with its English key.
std::vector<std::pair<std::string, wxString>> MenuTexts(wxMenuBar* bar)
{
    std::vector<std::pair<std::string, wxString>> texts = {{"&File", bar->GetMenuLabel(0)},
                                                           {"&Help", bar->GetMenuLabel(1)}};
    const std::pair<int, const char*> items[] = {{1001, "Create &Printer Profile..."},
                                                 {1002, "Create &Monitor Profile..."},
                                                 {1003, "Create &Device Link Profile..."},
                                                 {1005, "&Inspect Profile..."},
                                                 {1006, "&Edit Profile..."},
                                                 {1004, "&Verify Color..."},
                                                 {1007, "E&xit"},
                                                 {1015, "Veltrona &Help\tF1"},
                                                 {1016, "User Guide"},
                                                 {1017, "User Forum"},
                                                 {1107, "How-To"},
                                                 {1019, "&About Veltrona"},
                                                 {1023, "About &Modules"},
                                                 {1025, "Quenta Print Studio"},
                                                 {1026, "Zel Display Studio"},
                                                 {1027, "Quenta Link Studio"},
                                                 {1028, "Quenta Inspect Studio"},
                                                 {1029, "Quenta Edit Studio"},
                                                 {1030, "Zel Verify Studio"},
                                                 {1020, "Check for Updates..."}};
    for (const auto& item : items) {
        wxMenuItem* menuItem = bar->FindItem(item.first);
        texts.emplace_back(item.second, menuItem ? menuItem->GetItemLabel() : wxString("(none)"));
    }
    return texts;
}

} // namespace

TEST(IconBundle, FrameCarriesTheNineTrueColourIcons)
{
    Veltro3AppFrame* frame = new Veltro3AppFrame("Veltrona", wxDefaultPosition, wxDefaultSize);
    const wxIconBundle icons = frame->GetIcons();
    frame->Destroy();
    EXPECT_EQ(icons.GetIconCount(), 9u);
    EXPECT_EQ(Sizes(icons), (std::set<int>{16, 32, 48, 64, 72, 80, 96, 128, 256}));
    EXPECT_EQ(Sizes(LoadIconBundle("IDI_ICON1", 8)), (std::set<int>{16, 32, 48}));
    // A bundle keeps one icon per size, so all twelve images give nine.
    EXPECT_EQ(LoadIconBundle("IDI_ICON1", 0).GetIconCount(), 9u);
    EXPECT_TRUE(LoadIconBundle("IDI_ICON2", 32).IsEmpty());
}

TEST(IconBundle, DamagedOrMissingImagesAreSkipped)
{
    const ResourceImage& real = ResourceImage::OfExecutable();
    const ResourceEntry* group = real.Find(ResourceTypeGroupIcon, "IDI_ICON1");
    ASSERT_NE(group, nullptr);
    const std::vector<unsigned char> groupBytes(group->data, group->data + group->size);
    // Image 4 (256 pixels) whole, image 5 cut short, image 6 absent, the rest dropped.
    ResBuilder res;
    for (std::uint16_t id : {4, 5}) {
        const ResourceEntry* icon = real.Find(ResourceTypeIcon, id);
        ASSERT_NE(icon, nullptr);
        std::vector<unsigned char> bytes(icon->data, icon->data + icon->size);
        if (id == 5)
            bytes.resize(bytes.size() / 3);
        res.Add(ResourceTypeIcon, id, bytes);
    }
    std::vector<unsigned char> shortGroup = groupBytes;
    shortGroup.resize(6 + 14 * 6 + 5); // six whole entries and part of a seventh
    res.Add(ResourceTypeGroupIcon, "IDI_ICON1", shortGroup);
    const ResourceImage image(res.Bytes());
    EXPECT_EQ(Sizes(LoadIconBundle(image, "IDI_ICON1", 32)), std::set<int>{256});
    EXPECT_TRUE(LoadIconBundle(image, "IDI_ICON1", 8).IsEmpty());
}

TEST_P(MenusInLanguage, FileAndHelpMenusAreTranslated)
{
    wxLocale locale;
    StartTranslationsLikeLauncher(locale, GetParam().lang);
    std::map<std::string, std::string> expected;
    if (GetParam().catalog) {
        const std::vector<unsigned char> mo = EmbeddedCatalog(GetParam().catalog);
        expected = ReadCatalog(mo.data(), mo.size());
        ASSERT_FALSE(expected.empty());
    }
    Veltro3AppFrame* frame = new Veltro3AppFrame(_("Veltrona"), wxDefaultPosition, wxDefaultSize);
    int translated = 0;
    for (const auto& text : MenuTexts(frame->GetMenuBar())) {
        const auto found = expected.find(text.first);
        const std::string want = found != expected.end() ? found->second : text.first;
        EXPECT_EQ(std::string(text.second.utf8_str()), want) << text.first;
        translated += want != text.first;
    }
    frame->Destroy();
    // Product names keep their English form; everything else changes in a real translation.
    EXPECT_GE(translated, GetParam().catalog ? 13 : 0);
}

INSTANTIATE_TEST_SUITE_P(Languages, MenusInLanguage,
                         testing::Values(Language{"de_DE.UTF-8", "DE/VELTRO.MO"},
                                         Language{"fr_FR.UTF-8", "FR/VELTRO.MO"},
                                         Language{"es_ES.UTF-8", "ES/VELTRO.MO"},
                                         Language{"it_IT.UTF-8", "IT/VELTRO.MO"},
                                         Language{"nl_NL.UTF-8", "NL/VELTRO.MO"},
                                         Language{"ja_JP.UTF-8", "JA/VELTRO.MO"},
                                         Language{"zh_CN.UTF-8", "ZH_CN/VELTRO.MO"},
                                         Language{"pt_BR.UTF-8", "PT/VELTRO.MO"},
                                         Language{"ko_KR.UTF-8", nullptr},
                                         Language{"en_US.UTF-8", nullptr}),
                         [](const testing::TestParamInfo<Language>& info) {
                             std::string name = info.param.lang;
                             return name.substr(0, name.find('.'));
                         });

TEST(Translations, CataloguesLoadWhenTheSystemLocaleIsNotInstalled)
{
    // No system has this locale, so the toolkit reports an unknown language.
    wxLocale locale;
    StartTranslationsLikeLauncher(locale, "de_XX.UTF-8");
    EXPECT_FALSE(locale.IsOk());
    EXPECT_EQ(wxGetTranslation("E&xit"), wxString::FromUTF8("&Beenden"));
    EXPECT_EQ(wxGetTranslation("Veltrona"), "Veltrona");
}
