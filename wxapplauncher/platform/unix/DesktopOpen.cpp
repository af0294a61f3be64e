#include "platform/DesktopOpen.h"

#include "platform/ProcessStart.h"

#include <wx/process.h>

#include <utility>

namespace {

// Watches the opener: xdg-open starts at once and reports later, through its
// exit status, whether anything could open the target.
class OpenerProcess : public wxProcess
{
public:
    explicit OpenerProcess(std::function<void()> onFailure) : m_onFailure(std::move(onFailure)) {}

    void OnTerminate(int, int status) override
    {
        if (status != 0 && m_onFailure)
            m_onFailure();
        delete this;
    }

private:
    std::function<void()> m_onFailure;
};

} // namespace

void OpenWithDesktop(const wxString& target, std::function<void()> onFailure)
{
    wxArrayString argv;
    argv.Add("xdg-open");
    argv.Add(target);
    auto* process = new OpenerProcess(onFailure);
    if (StartProcess(argv, process) == 0) {
        delete process;
        if (onFailure)
            onFailure();
    }
}
