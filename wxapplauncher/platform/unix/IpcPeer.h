// The server's side of the IPC protocol apart from sockets and event loops: a
// peer's bytes go in, in whatever pieces they arrive; its conversation, its pokes
// and the code bytes to answer come out. Also the bounded table of a server's peers.
#pragma once

#include "platform/Ipc.h"
#include "platform/unix/IpcWire.h"

#include <chrono>
#include <memory>
#include <string>
#include <vector>

// The largest message a peer may send: a poke with the longest item and the most data.
constexpr size_t kIpcMaxMessageSize = 1 + 4 + kIpcMaxNameSize + 1 + 4 + kIpcMaxPokeSize;

// The most peers a server holds at once: a flood of idle peers never exhausts
// the launcher's descriptors.
constexpr size_t kIpcMaxPeers = 16;

// One peer: it opens one conversation, then pokes until it disconnects.
class IpcPeer
{
public:
    enum class State
    {
        Waiting, // for the message that opens its conversation
        Open,    // its conversation is open: it may poke
        Closed,  // done or refused; to be dropped
    };
    enum class Step
    {
        Keep,  // go on reading
        Pause, // inside its own poke and no more is taken: read no more; the
               // handling further up the stack drops it once the poke returns
        Drop,  // it is closed: drop it now
    };

    IpcPeer() = default;
    IpcPeer(const IpcPeer&) = delete;
    IpcPeer& operator=(const IpcPeer&) = delete;
    virtual ~IpcPeer() = default;

    // Takes bytes the peer sent (`size` 0: its stream ended) and handles every
    // complete message at the front of what it holds.
    Step Receive(const char* data, size_t size);

    State GetState() const;
    // Inside its OnPoke, which may run nested event loops: never dropped meanwhile.
    bool IsBusy() const { return m_busy; }
    std::chrono::steady_clock::time_point GetDeadline() const { return m_deadline; }
    // The bytes held of its next messages.
    size_t GetHeldSize() const { return m_input.size(); }

protected:
    // The connection for a conversation on `topic`; null refuses it.
    virtual wxConnectionBase* Accept(const wxString& topic) = 0;
    // Sends one code byte without waiting; false when it could not be sent.
    virtual bool Answer(IpcCode code) = 0;

private:
    bool HandleMessages();

    std::string m_input;
    // By which its next message must be complete.
    std::chrono::steady_clock::time_point m_deadline =
        std::chrono::steady_clock::now() + std::chrono::milliseconds(kIpcPeerTimeoutMs);
    std::unique_ptr<wxConnectionBase> m_connection;
    wxString m_topic;
    bool m_busy = false;
    // Its stream ended, or it sent too much during its poke: no more is taken.
    bool m_ended = false;
    bool m_closed = false;
};

// A server's peers, oldest first.
class IpcPeerTable
{
public:
    // Takes a new peer; at the limit the oldest one not inside a poke goes. When
    // every one is inside a poke the newcomer is refused (and deleted): false.
    bool Add(std::unique_ptr<IpcPeer> peer);
    void Drop(const IpcPeer& peer);
    // Drops the peers whose next message is late at `now`.
    void DropLate(std::chrono::steady_clock::time_point now);
    void Clear() { m_peers.clear(); }
    size_t Size() const { return m_peers.size(); }

private:
    std::vector<std::unique_ptr<IpcPeer>> m_peers;
};
