#include "platform/Ipc.h"

#include <windows.h>

#include <dde.h>
#include <ddeml.h>

#include <algorithm>
#include <chrono>
#include <functional>
#include <limits>
#include <memory>
#include <mutex>
#include <string>
#include <system_error>
#include <thread>
#include <vector>

namespace {

using Clock = std::chrono::steady_clock;

// DDE names are atoms.
const size_t kMaxAtomLength = 255;

HDDEDATA CALLBACK ClientCallback(UINT, UINT, HCONV, HSZ, HSZ, HDDEDATA, ULONG_PTR, ULONG_PTR)
{
    return nullptr;
}

DWORD MillisecondsLeft(Clock::time_point deadline)
{
    const auto left =
        std::chrono::duration_cast<std::chrono::milliseconds>(deadline - Clock::now()).count();
    return left > 0 ? static_cast<DWORD>(left) : 0;
}

// Waits for `event` until the deadline while this thread goes on answering
// DDE: connecting asks every top-level window, this thread's own included, and
// waits for each answer; a server of this thread sees pokes only as posted
// messages. Nothing else is dispatched meanwhile.
bool WaitServingDde(HANDLE event, Clock::time_point deadline)
{
    for (;;) {
        const DWORD woke = MsgWaitForMultipleObjectsEx(1, &event, MillisecondsLeft(deadline),
                                                       QS_SENDMESSAGE | QS_POSTMESSAGE, 0);
        if (woke == WAIT_OBJECT_0)
            return true;
        if (woke != WAIT_OBJECT_0 + 1)
            return false;
        MSG message;
        while (PeekMessageW(&message, nullptr, WM_DDE_FIRST, WM_DDE_LAST, PM_REMOVE))
            DispatchMessageW(&message);
    }
}

// A string handle of the client's instance, freed with it.
class StringHandle
{
public:
    StringHandle(DWORD instance, const std::wstring& text)
        : m_instance(instance),
          m_handle(DdeCreateStringHandleW(instance, text.c_str(), CP_WINUNICODE))
    {
    }
    ~StringHandle()
    {
        if (m_handle)
            DdeFreeStringHandle(m_instance, m_handle);
    }
    StringHandle(const StringHandle&) = delete;
    StringHandle& operator=(const StringHandle&) = delete;
    HSZ Get() const { return m_handle; }

private:
    DWORD m_instance;
    HSZ m_handle;
};

} // namespace

// One conversation, held by a DDEML client of its own on a thread of its own:
// DDEML belongs to the thread that started it, and a server that stops
// answering (or any top-level window that does, while connecting) then holds
// up that thread only. The caller waits for each step until the conversation's
// deadline and then gives up; the thread ends the conversation as soon as its
// step comes back.
class IpcChannel
{
public:
    using Step = std::function<bool(DWORD instance, HCONV& conversation)>;

    explicit IpcChannel(Clock::time_point deadline)
        : m_shared(std::make_shared<Shared>()), m_deadline(deadline)
    {
    }

    ~IpcChannel()
    {
        Finish();
        if (m_started)
            WaitServingDde(m_shared->ended, m_deadline);
    }

    IpcChannel(const IpcChannel&) = delete;
    IpcChannel& operator=(const IpcChannel&) = delete;

    bool Start()
    {
        if (!m_shared->wake || !m_shared->done || !m_shared->ended)
            return false;
        try {
            std::thread(Serve, m_shared).detach();
        } catch (const std::system_error&) {
            return false;
        }
        m_started = true;
        return true;
    }

    // Runs `step` on the conversation's thread; false when it failed or did not
    // come back by the deadline, after which the conversation is over.
    bool Run(Step step)
    {
        {
            std::lock_guard<std::mutex> lock(m_shared->mutex);
            if (m_shared->finished)
                return false;
            m_shared->step = std::move(step);
        }
        SetEvent(m_shared->wake);
        if (!WaitServingDde(m_shared->done, m_deadline)) {
            Finish();
            return false;
        }
        std::lock_guard<std::mutex> lock(m_shared->mutex);
        return m_shared->result;
    }

    Clock::time_point Deadline() const { return m_deadline; }

private:
    struct Shared
    {
        ~Shared()
        {
            for (HANDLE event : {wake, done, ended})
                if (event)
                    CloseHandle(event);
        }
        const HANDLE wake = CreateEventW(nullptr, FALSE, FALSE, nullptr);
        const HANDLE done = CreateEventW(nullptr, FALSE, FALSE, nullptr);
        const HANDLE ended = CreateEventW(nullptr, TRUE, FALSE, nullptr);
        std::mutex mutex;
        Step step;
        bool result = false;
        bool finished = false;
    };

    void Finish()
    {
        {
            std::lock_guard<std::mutex> lock(m_shared->mutex);
            m_shared->finished = true;
        }
        SetEvent(m_shared->wake);
    }

    // The conversation's thread: its own message loop, so that it answers what
    // other programs send its windows while it waits for the next step.
    static void Serve(std::shared_ptr<Shared> shared)
    {
        DWORD instance = 0;
        const bool ready =
            DdeInitializeW(&instance, ClientCallback, APPCMD_CLIENTONLY, 0) == DMLERR_NO_ERROR;
        HCONV conversation = nullptr;
        for (;;) {
            const DWORD woke = MsgWaitForMultipleObjectsEx(1, &shared->wake, INFINITE, QS_ALLINPUT,
                                                           MWMO_INPUTAVAILABLE);
            if (woke == WAIT_OBJECT_0 + 1) {
                MSG message;
                while (PeekMessageW(&message, nullptr, 0, 0, PM_REMOVE)) {
                    TranslateMessage(&message);
                    DispatchMessageW(&message);
                }
                continue;
            }
            Step step;
            {
                std::lock_guard<std::mutex> lock(shared->mutex);
                step = std::move(shared->step);
                shared->step = nullptr;
            }
            if (step) {
                const bool result = ready && step(instance, conversation);
                std::lock_guard<std::mutex> lock(shared->mutex);
                shared->result = result;
                SetEvent(shared->done);
            }
            std::lock_guard<std::mutex> lock(shared->mutex);
            if (shared->finished)
                break;
        }
        if (conversation)
            DdeDisconnect(conversation);
        if (ready)
            DdeUninitialize(instance);
        SetEvent(shared->ended);
    }

    std::shared_ptr<Shared> m_shared;
    const Clock::time_point m_deadline;
    bool m_started = false;
};

bool IsServiceNameUsable(const wxString& service)
{
    return !service.empty() && service.length() <= kMaxAtomLength &&
           service.Find(wxUniChar(0)) == wxNOT_FOUND;
}

IpcConnection::IpcConnection() = default;

IpcConnection::~IpcConnection()
{
    Disconnect();
}

bool IpcConnection::Disconnect()
{
    m_channel.reset();
    SetConnected(false);
    return true;
}

// Byte text (UTF-8) travels as Windows' Unicode text, which every DDE peer of
// the suite reads, so a path of any length and script arrives whole.
bool IpcConnection::DoPoke(const wxString& item, const void* data, size_t size, wxIPCFormat format)
{
    if (!m_channel || !data || size > std::numeric_limits<DWORD>::max())
        return false;
    const unsigned char* bytes = static_cast<const unsigned char*>(data);
    std::vector<unsigned char> payload(bytes, bytes + size);
    UINT clipboardFormat = format;
    if (format == wxIPC_TEXT || format == wxIPC_UTF8TEXT) {
        const char* text = static_cast<const char*>(data);
        size_t length = 0;
        while (length < size && text[length])
            ++length;
        const wxString decoded = wxString::FromUTF8(text, length);
        if (length > 0 && decoded.empty())
            return false;
        const std::wstring wide = decoded.ToStdWstring();
        const unsigned char* units = reinterpret_cast<const unsigned char*>(wide.c_str());
        payload.assign(units, units + (wide.size() + 1) * sizeof(wchar_t));
        clipboardFormat = CF_UNICODETEXT;
    }
    const std::wstring name = item.ToStdWstring();
    const Clock::time_point deadline = m_channel->Deadline();
    // Every poke asks its peer to show something (the running copy's frame, a
    // help page): the peer may take the foreground.
    AllowSetForegroundWindow(ASFW_ANY);
    return m_channel->Run([name, payload, clipboardFormat, deadline](DWORD instance,
                                                                     HCONV& conversation) {
        const StringHandle itemHandle(instance, name);
        DWORD status = 0;
        // The system's own timeout ends a transaction the caller gave up on.
        // The server's answer is in the status: Wine reports success either way.
        return itemHandle.Get() &&
               DdeClientTransaction(
                   const_cast<unsigned char*>(payload.data()), static_cast<DWORD>(payload.size()),
                   conversation, itemHandle.Get(), clipboardFormat, XTYP_POKE,
                   std::max<DWORD>(MillisecondsLeft(deadline), 1), &status) != nullptr &&
               (status & DDE_FACK) != 0;
    });
}

wxConnectionBase* IpcClient::Connect(const wxString& service, const wxString& topic, int timeoutMs)
{
    if (!IsServiceNameUsable(service) || topic.length() > kMaxAtomLength)
        return nullptr;
    auto channel =
        std::make_unique<IpcChannel>(Clock::now() + std::chrono::milliseconds(timeoutMs));
    const std::wstring serviceName = service.ToStdWstring(), topicName = topic.ToStdWstring();
    if (!channel->Start() ||
        !channel->Run([serviceName, topicName](DWORD instance, HCONV& conversation) {
            const StringHandle serviceHandle(instance, serviceName);
            const StringHandle topicHandle(instance, topicName);
            if (serviceHandle.Get() && topicHandle.Get())
                conversation =
                    DdeConnect(instance, serviceHandle.Get(), topicHandle.Get(), nullptr);
            return conversation != nullptr;
        }))
        return nullptr;
    auto connection = std::make_unique<IpcConnection>();
    connection->m_channel = std::move(channel);
    return connection.release();
}
