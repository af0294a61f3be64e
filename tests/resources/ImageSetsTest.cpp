// The embedded image sets: every picture by its resource name at its size, the XRC
// documents, and registration once per process whoever asks first.
#include "resources/ImageSets.h"
#include "frame/Veltro3AppFrame.h"

#include <gtest/gtest.h>
#include <wx/filesys.h>
#include <wx/image.h>
#include <wx/log.h>
#include <wx/xrc/xmlres.h>

#include <memory>

namespace {

struct Picture
{
    const char* name;
    int width, height;
};

const Picture pictures[] = {
    {"Veltro2AppFrame::SplashAboutMainApp", 443, 454},
    {"Veltro2AppFrame::SplashMainApp", 445, 425},
    {"Veltro2AppFrame::LauncherBG", 566, 345},
    {"Veltro2AppFrame::MonitorModule", 48, 48},
    {"Veltro2AppFrame::MonitorModuleActive", 48, 48},
    {"Veltro2AppFrame::MonitorModuleSelected", 48, 48},
    {"Veltro2AppFrame::PrinterModule", 48, 48},
    {"Veltro2AppFrame::PrinterModuleActive", 48, 48},
    {"Veltro2AppFrame::PrinterModuleSelected", 48, 48},
    {"Veltro2AppFrame::LinkStudioModule", 48, 48},
    {"Veltro2AppFrame::LinkStudioModuleActive", 48, 48},
    {"Veltro2AppFrame::LinkStudioModuleSelected", 48, 48},
    {"Veltro2AppFrame::InspectorModule", 48, 48},
    {"Veltro2AppFrame::InspectorModuleActive", 48, 48},
    {"Veltro2AppFrame::InspectorModuleSelected", 48, 48},
    {"Veltro2AppFrame::EditModule", 48, 48},
    {"Veltro2AppFrame::EditModuleActive", 48, 48},
    {"Veltro2AppFrame::EditModuleSelected", 48, 48},
    {"Veltro2AppFrame::HighlightBackground", 152, 58},
    {"Veltro2AppFrame::HighlightPressed", 152, 58},
    {"Veltro2AppFrame::VerifierModule", 48, 48},
    {"Veltro2AppFrame::VerifierModuleActive", 48, 48},
    {"Veltro2AppFrame::VerifierModuleSelected", 48, 48},
    {"Veltro2AppFrame::Help", 24, 24},
    {"Helper::ModuleSplash", 440, 100},
};

wxString MemoryText(const wxString& path)
{
    wxFileSystem fs;
    std::unique_ptr<wxFSFile> file(fs.OpenFile("memory:" + path));
    if (!file)
        return wxString();
    wxInputStream* in = file->GetStream();
    std::string bytes;
    char buffer[4096];
    while (in->Read(buffer, sizeof buffer).LastRead() > 0)
        bytes.append(buffer, in->LastRead());
    return wxString(bytes.c_str(), wxConvISO8859_1);
}

// Records the errors the toolkit logs, such as a file added twice to the memory file system.
class ErrorRecorder : public wxLog
{
public:
    int errors = 0;

protected:
    void DoLogRecord(wxLogLevel level, const wxString&, const wxLogRecordInfo&) override
    {
        if (level <= wxLOG_Error)
            ++errors;
    }
};

} // namespace

TEST(ImageSets, EveryPictureLoadsByNameAtItsSize)
{
    EnsureLauncherImages();
    EnsureHelpImages();
    EnsureCommonImages();
    for (const Picture& p : pictures) {
        const wxBitmap bitmap = wxXmlResource::Get()->LoadBitmap(p.name);
        ASSERT_TRUE(bitmap.IsOk()) << p.name;
        EXPECT_EQ(bitmap.GetSize(), wxSize(p.width, p.height)) << p.name;
        EXPECT_TRUE(bitmap.ConvertToImage().HasAlpha()) << p.name;
    }
    // The Inspect icon is the file stored under the odd name "inpect_normal.png".
    wxFileSystem fs;
    std::unique_ptr<wxFSFile> file(
        fs.OpenFile("memory:XRC_resource/Veltro3AppFrameImages$inpect_normal.png"));
    ASSERT_TRUE(file);
    const wxImage stored(*file->GetStream(), wxBITMAP_TYPE_PNG);
    const wxImage loaded =
        wxXmlResource::Get()->LoadBitmap("Veltro2AppFrame::InspectorModule").ConvertToImage();
    ASSERT_TRUE(stored.IsOk());
    EXPECT_EQ(0, memcmp(stored.GetData(), loaded.GetData(), 48 * 48 * 3));
    EXPECT_EQ(0, memcmp(stored.GetAlpha(), loaded.GetAlpha(), 48 * 48));
    wxLogNull quiet; // the toolkit reports the unknown name as an error
    EXPECT_FALSE(wxXmlResource::Get()->LoadBitmap("Veltro2AppFrame::NoSuchPicture").IsOk());
}

TEST(ImageSets, XrcDocumentsNameEachPictureByItsMemoryPath)
{
    EnsureLauncherImages();
    EnsureHelpImages();
    EnsureCommonImages();
    const wxString launcher =
        MemoryText("XRC_resource/Veltro3AppFrameImages$._Veltro2AppFrameImages.xrc");
    EXPECT_TRUE(launcher.StartsWith("<?xml version=\"1.0\" encoding=\"ISO-8859-1\"?>\n"
                                    "<resource version=\"2.3.0.1\">\n"
                                    "<object class=\"wxBitmap\" "
                                    "name=\"Veltro2AppFrame::SplashAboutMainApp\">"
                                    "Veltro3AppFrameImages$Images_splash_About_graphic.png"
                                    "</object>\n"))
        << launcher;
    EXPECT_EQ(launcher.Freq('\n'), 23 + 3);
    EXPECT_TRUE(launcher.Contains("name=\"Veltro2AppFrame::InspectorModule\">"
                                  "Veltro3AppFrameImages$inpect_normal.png<"));
    EXPECT_TRUE(MemoryText("XRC_resource/Veltro2AppFrameHelpImages$._Veltro2AppFrameHelpImages.xrc")
                    .Contains(">Veltro2AppFrameHelpImages$Images_help_24x24.png<"));
    EXPECT_TRUE(MemoryText("XRC_resource/CommonImages$._CommonImages.xrc")
                    .Contains("name=\"Helper::ModuleSplash\">"
                              "CommonImages$images_modulesplash_zel.png<"));
    EXPECT_TRUE(MemoryText("XRC_resource/dummy_file").empty()) << "the probe file stays behind";
}

TEST(ImageSets, SplashThenFrameRegistersTheLauncherSetOnce)
{
    ErrorRecorder* recorder = new ErrorRecorder;
    std::unique_ptr<wxLog> previous(wxLog::SetActiveTarget(recorder));
    EnsureLauncherImages(); // as the splash screen does
    Veltro3AppFrame* frame = new Veltro3AppFrame("Veltrona", wxDefaultPosition, wxDefaultSize);
    frame->Destroy();
    EnsureHelpImages();
    EnsureCommonImages();
    EnsureCommonImages();
    EXPECT_EQ(recorder->errors, 0);
    // A second registration is what the guards prevent: the toolkit reports it.
    RegisterHelpImages();
    EXPECT_GT(recorder->errors, 0);
    wxLog::SetActiveTarget(previous.release());
    delete recorder;
}
