#include "app/Veltro3AppLauncherIPC.h"

#include "app/Veltro3App.h"
#include "frame/Veltro3AppFrame.h"

wxConnectionBase* Veltro3AppLauncherIPCServer::OnAcceptConnection(const wxString& topic)
{
    if (topic != "IPC START")
        return nullptr;
    return new Veltro3AppLauncherIPCConnection;
}

bool Veltro3AppLauncherIPCConnection::OnPoke(const wxString&, const wxString& item,
                                             const void* data, size_t size, wxIPCFormat format)
{
    if (item != "Application")
        return false;
    Veltro3App* app = GetVeltro3App();
    if (!app)
        return false;
    // The frame the application still knows, not one being destroyed: a poke
    // during shutdown changes nothing. Before the frame is made (the start-up
    // splash lets events through meanwhile) a path waits like any other.
    Veltro3AppFrame* frame = app->m_frame;
    const bool frameToCome = !frame && app->m_deferredStartupPending;
    if (!frameToCome && (!frame || frame->IsBeingDeleted() || app->GetTopWindow() != frame))
        return false;

    wxString text;
    if (!ReadPokeText(data, size, format, text) || !text.StartsWith("Raise"))
        return false;
    const bool withPath = text.length() > 5 && text[5] == '*';
    if (withPath && !text.StartsWith("Raise* "))
        return false;

    // A frame still hidden behind the splash screen is neither shown nor raised.
    if (frame && frame->IsShown()) {
        if (frame->IsIconized())
            frame->Iconize(false);
        frame->Raise();
    }
    if (withPath) {
        app->m_pendingFile = text.Mid(7);
        app->OpenPendingFile();
    }
    return true;
}
