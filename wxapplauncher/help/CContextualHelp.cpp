#include "help/CContextualHelp.h"

// The help viewer is not reachable yet: no service is registered and no page is sent.
CContextualHelp::CContextualHelp(const wxString& appName) : m_appName(appName) {}

CContextualHelp::~CContextualHelp() = default;

void CContextualHelp::Start() {}

void CContextualHelp::ShowTopic(const wxString&) {}
