#include "support/ProbeRun.h"

#include "support/GuiWait.h"
#include "support/StandinLog.h"

#include <fstream>
#include <sstream>
#include <wx/utils.h>

std::string ProbeLogPath(const std::string& installDir)
{
    static int probes = 0;
    return installDir + "/probe-" + std::to_string(wxGetProcessId()) + "-" +
           std::to_string(++probes) + ".log";
}

std::vector<ProbeEvent> ReadEventLog(const std::string& path)
{
    std::vector<ProbeEvent> events;
    std::ifstream in(path);
    std::string line;
    while (std::getline(in, line)) {
        ProbeEvent event;
        std::stringstream fields(line);
        std::string field;
        std::getline(fields, event.kind, '\t');
        while (std::getline(fields, field, '\t'))
            event.fields.push_back(UnescapeField(field));
        events.push_back(event);
    }
    return events;
}

std::vector<ProbeEvent> ProbeRun::Events() const
{
    return ReadEventLog(m_log);
}

std::vector<ProbeEvent> ProbeRun::Events(const std::string& kind) const
{
    std::vector<ProbeEvent> matching;
    for (const ProbeEvent& event : Events())
        if (event.kind == kind)
            matching.push_back(event);
    return matching;
}

bool ProbeRun::WaitForShown(int timeoutMs) const
{
    // The main frame is the first titled window; the splash before it has no title.
    return WaitFor(
        [this] {
            for (const ProbeEvent& event : Events("shown"))
                if (!event.fields.empty() && !event.fields[0].empty())
                    return true;
            return false;
        },
        timeoutMs);
}
