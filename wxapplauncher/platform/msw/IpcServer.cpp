#include "platform/Ipc.h"

#include <wx/strconv.h>

#include <windows.h>

#include <ddeml.h>

#include <algorithm>
#include <memory>
#include <string>
#include <vector>

// The toolkit's DDE server acknowledges every poke whatever OnPoke answers and
// copies a poke of any size before anyone looks at it; this one is DDEML as
// the toolkit uses it (one instance on the GUI thread, callbacks through the
// event loop) with the answer passed on and the size checked first.
namespace {

// Conversations beyond this push out the oldest one that is not busy: a flood
// of idle peers never grows the launcher without end.
const size_t kMaxConversations = 16;

// Text in Windows' Unicode form takes up to two bytes for each byte of UTF-8.
const DWORD kMaxPokeBytes = 2 * kIpcMaxPokeSize;

struct Conversation
{
    HCONV handle = nullptr;
    IpcListener* listener = nullptr;
    wxString topic;
    std::unique_ptr<wxConnectionBase> connection;
    // Inside its OnPoke, which may run nested event loops: not deleted meanwhile.
    bool busy = false;
    // Ended while busy: deleted once the poke in progress returns.
    bool ended = false;
};

// The process's server side of DDEML, used on the GUI thread only.
struct ServerState
{
    DWORD instance = 0;
    std::vector<IpcListener*> listeners;
    std::vector<std::unique_ptr<Conversation>> conversations;
    // Accepted, not yet given its handle by the system.
    std::unique_ptr<Conversation> connecting;
};

ServerState& State()
{
    static ServerState state;
    return state;
}

wxString QueryString(HSZ handle)
{
    const DWORD length = DdeQueryStringW(State().instance, handle, nullptr, 0, CP_WINUNICODE);
    if (length == 0 || length > kIpcMaxNameSize)
        return wxString();
    std::wstring text(length + 1, L'\0');
    DdeQueryStringW(State().instance, handle, &text[0], length + 1, CP_WINUNICODE);
    text.resize(length);
    return wxString(text);
}

// UTF-16 text up to its first NUL, as UTF-8 with the NUL; false when it holds
// a lone surrogate.
bool Utf16ToUtf8(const std::vector<unsigned char>& data, std::string& utf8)
{
    std::wstring text;
    for (size_t i = 0; i + 1 < data.size(); i += 2) {
        const wchar_t unit = static_cast<wchar_t>(data[i] | data[i + 1] << 8);
        if (unit == 0)
            break;
        text += unit;
    }
    utf8 = wxString(text).utf8_string();
    if (!text.empty() && utf8.empty())
        return false;
    utf8 += '\0';
    return true;
}

// What a poke carries, as the connection's OnPoke takes it: text in any of the
// forms the suite's peers send becomes UTF-8 (wxIPC_UTF8TEXT); other formats
// pass unchanged. Unicode text; text the toolkit's 2.8 Unicode build marks as
// CF_TEXT although it is UTF-16 (told by a NUL as its second byte); and byte
// text, UTF-8 where it is valid and else in the system's ANSI code page, as
// CF_TEXT means on Windows.
bool PokeData(UINT format, std::vector<unsigned char>& data, wxIPCFormat& passed)
{
    passed = static_cast<wxIPCFormat>(format);
    const bool wideText =
        format == CF_UNICODETEXT || (format == CF_TEXT && data.size() >= 2 &&
                                     data.size() % 2 == 0 && data[0] != 0 && data[1] == 0);
    std::string utf8;
    if (wideText) {
        if (!Utf16ToUtf8(data, utf8))
            return false;
    } else if (format == CF_TEXT) {
        const char* text = reinterpret_cast<const char*>(data.data());
        const size_t length = std::find(data.begin(), data.end(), 0) - data.begin();
        wxString decoded = wxString::FromUTF8(text, length);
        if (length > 0 && decoded.empty())
            decoded = wxString(text, wxConvLocal, length);
        utf8 = decoded.utf8_string() + '\0';
    } else {
        return data.size() <= kIpcMaxPokeSize;
    }
    data.assign(utf8.begin(), utf8.end());
    passed = wxIPC_UTF8TEXT;
    return true;
}

void ReleaseInstanceIfUnused()
{
    ServerState& state = State();
    if (state.instance && state.listeners.empty() && state.conversations.empty()) {
        state.connecting.reset();
        DdeUninitialize(state.instance);
        state.instance = 0;
    }
}

Conversation* FindConversation(HCONV handle)
{
    for (const auto& conversation : State().conversations)
        if (conversation->handle == handle)
            return conversation.get();
    return nullptr;
}

void Forget(const Conversation* conversation)
{
    auto& conversations = State().conversations;
    conversations.erase(
        std::remove_if(conversations.begin(), conversations.end(),
                       [conversation](const auto& held) { return held.get() == conversation; }),
        conversations.end());
    ReleaseInstanceIfUnused();
}

bool Accept(HSZ topic, HSZ service);
void Confirm(HCONV handle);
void Ended(HCONV handle);
bool Poke(HCONV handle, HSZ item, UINT format, HDDEDATA data);

HDDEDATA CALLBACK ServerCallback(UINT type, UINT format, HCONV handle, HSZ first, HSZ second,
                                 HDDEDATA data, ULONG_PTR, ULONG_PTR)
{
    switch (type) {
    case XTYP_CONNECT:
        return reinterpret_cast<HDDEDATA>(static_cast<ULONG_PTR>(Accept(first, second)));
    case XTYP_CONNECT_CONFIRM:
        Confirm(handle);
        return nullptr;
    case XTYP_DISCONNECT:
        Ended(handle);
        return nullptr;
    case XTYP_POKE:
        return reinterpret_cast<HDDEDATA>(static_cast<ULONG_PTR>(
            Poke(handle, second, format, data) ? DDE_FACK : DDE_FNOTPROCESSED));
    default:
        return nullptr;
    }
}

} // namespace

// One registered service name of the process's DDEML instance.
class IpcListener
{
public:
    explicit IpcListener(IpcServer& server) : m_server(server) {}

    bool Register(const wxString& service)
    {
        ServerState& state = State();
        if (!state.instance &&
            DdeInitializeW(&state.instance, ServerCallback,
                           APPCLASS_STANDARD | CBF_FAIL_EXECUTES | CBF_FAIL_REQUESTS |
                               CBF_FAIL_ADVISES | CBF_SKIP_REGISTRATIONS | CBF_SKIP_UNREGISTRATIONS,
                           0) != DMLERR_NO_ERROR) {
            state.instance = 0;
            return false;
        }
        state.listeners.push_back(this);
        m_service = DdeCreateStringHandleW(state.instance, service.wc_str(), CP_WINUNICODE);
        return m_service && DdeNameService(state.instance, m_service, nullptr, DNS_REGISTER);
    }

    // Gives up the name unless another server of this process still holds it,
    // and ends the conversations.
    ~IpcListener()
    {
        ServerState& state = State();
        state.listeners.erase(std::find(state.listeners.begin(), state.listeners.end(), this));
        if (m_service) {
            if (!Serves(m_service))
                DdeNameService(state.instance, m_service, nullptr, DNS_UNREGISTER);
            DdeFreeStringHandle(state.instance, m_service);
        }
        if (state.connecting && state.connecting->listener == this)
            state.connecting.reset();
        std::vector<Conversation*> own;
        for (const auto& conversation : state.conversations)
            if (conversation->listener == this)
                own.push_back(conversation.get());
        for (Conversation* conversation : own) {
            DdeDisconnect(conversation->handle);
            conversation->listener = nullptr;
            if (conversation->busy)
                conversation->ended = true;
            else
                Forget(conversation);
        }
        ReleaseInstanceIfUnused();
    }

    IpcListener(const IpcListener&) = delete;
    IpcListener& operator=(const IpcListener&) = delete;

    // The listener of `service`, the newest first.
    static IpcListener* Of(HSZ service)
    {
        const auto& listeners = State().listeners;
        for (auto it = listeners.rbegin(); it != listeners.rend(); ++it)
            if ((*it)->m_service && DdeCmpStringHandles((*it)->m_service, service) == 0)
                return *it;
        return nullptr;
    }

    IpcServer& m_server;

private:
    static bool Serves(HSZ service) { return Of(service) != nullptr; }

    HSZ m_service = nullptr;
};

namespace {

bool Accept(HSZ topic, HSZ service)
{
    IpcListener* listener = IpcListener::Of(service);
    if (!listener)
        return false;
    auto conversation = std::make_unique<Conversation>();
    conversation->listener = listener;
    conversation->topic = QueryString(topic);
    conversation->connection.reset(listener->m_server.OnAcceptConnection(conversation->topic));
    if (!conversation->connection)
        return false;
    State().connecting = std::move(conversation);
    return true;
}

void Confirm(HCONV handle)
{
    ServerState& state = State();
    if (!state.connecting)
        return;
    if (state.conversations.size() >= kMaxConversations) {
        const auto oldest = std::find_if(state.conversations.begin(), state.conversations.end(),
                                         [](const auto& held) { return !held->busy; });
        if (oldest != state.conversations.end()) {
            DdeDisconnect((*oldest)->handle);
            state.conversations.erase(oldest);
        }
    }
    state.connecting->handle = handle;
    state.conversations.push_back(std::move(state.connecting));
}

void Ended(HCONV handle)
{
    Conversation* conversation = FindConversation(handle);
    if (!conversation)
        return;
    if (conversation->busy)
        conversation->ended = true;
    else
        Forget(conversation);
}

bool Poke(HCONV handle, HSZ item, UINT format, HDDEDATA data)
{
    Conversation* conversation = FindConversation(handle);
    if (!conversation || conversation->ended || conversation->busy || !data)
        return false;
    // The size first: a poke too big for any acceptable text is not copied.
    const DWORD size = DdeGetData(data, nullptr, 0, 0);
    if (size > kMaxPokeBytes)
        return false;
    std::vector<unsigned char> bytes(size);
    wxIPCFormat passed = wxIPC_INVALID;
    if (DdeGetData(data, bytes.data(), size, 0) != size || !PokeData(format, bytes, passed))
        return false;
    const wxString itemName = QueryString(item);
    conversation->busy = true;
    const bool processed = conversation->connection->OnPoke(conversation->topic, itemName,
                                                            bytes.data(), bytes.size(), passed);
    conversation->busy = false;
    if (conversation->ended)
        Forget(conversation);
    return processed;
}

} // namespace

IpcServer::IpcServer() = default;

IpcServer::~IpcServer() = default;

bool IpcServer::Create(const wxString& service)
{
    m_listener.reset();
    if (!IsServiceNameUsable(service))
        return false;
    auto listener = std::make_unique<IpcListener>(*this);
    if (!listener->Register(service))
        return false;
    m_listener = std::move(listener);
    return true;
}

wxConnectionBase* IpcServer::OnAcceptConnection(const wxString&)
{
    return nullptr;
}
