#include "platform/unix/IpcPeer.h"

#include "platform/LittleEndian.h"

#include <algorithm>

namespace {

enum class Read
{
    Ok,
    More, // the message is not complete yet
    Bad,  // a length beyond its limit, or a message the peer may not send now
};

// Reads the fields of one message from the front of a peer's input. Lengths are
// checked before their bytes are waited for or kept.
class FieldReader
{
public:
    explicit FieldReader(const std::string& input) : m_input(input) {}

    Read Byte(unsigned char& value)
    {
        if (m_input.size() - m_used < 1)
            return Read::More;
        value = static_cast<unsigned char>(m_input[m_used++]);
        return Read::Ok;
    }

    Read Block(std::string& value, size_t limit)
    {
        if (m_input.size() - m_used < 4)
            return Read::More;
        const std::uint32_t size =
            Le32(reinterpret_cast<const unsigned char*>(m_input.data()) + m_used);
        if (size > limit)
            return Read::Bad;
        if (m_input.size() - m_used - 4 < size)
            return Read::More;
        value.assign(m_input, m_used + 4, size);
        m_used += 4 + size;
        return Read::Ok;
    }

    size_t Used() const { return m_used; }

private:
    const std::string& m_input;
    size_t m_used = 0;
};

struct Message
{
    unsigned char code = 0, format = 0;
    std::string name, data;
};

Read ReadMessage(FieldReader& in, bool connected, Message& message)
{
    Read read = in.Byte(message.code);
    if (read != Read::Ok)
        return read;
    if (message.code == kIpcConnect && !connected)
        return in.Block(message.name, kIpcMaxNameSize);
    if (message.code != kIpcPoke || !connected)
        return Read::Bad;
    if ((read = in.Block(message.name, kIpcMaxNameSize)) != Read::Ok ||
        (read = in.Byte(message.format)) != Read::Ok)
        return read;
    return in.Block(message.data, kIpcMaxPokeSize);
}

} // namespace

IpcPeer::Step IpcPeer::Receive(const char* data, size_t size)
{
    // During its own poke a peer may queue one largest message's worth; what it
    // sends beyond that ends its stream rather than growing the input.
    if (size == 0 || (m_busy && m_input.size() + size > kIpcMaxMessageSize))
        m_ended = true;
    else
        m_input.append(data, size);
    // A nested event loop inside the peer's own OnPoke: the handling further up
    // the stack goes on with what arrived, and drops the peer when it is done.
    if (m_busy)
        return m_ended ? Step::Pause : Step::Keep;
    // The end of the stream ends the conversation once what came before is handled.
    if (!HandleMessages() || m_ended) {
        m_closed = true;
        return Step::Drop;
    }
    return Step::Keep;
}

IpcPeer::State IpcPeer::GetState() const
{
    if (m_closed)
        return State::Closed;
    return m_connection ? State::Open : State::Waiting;
}

// Handles every complete message at the front of the input; false when the peer
// is to be dropped.
bool IpcPeer::HandleMessages()
{
    for (;;) {
        FieldReader in(m_input);
        Message message;
        const Read read = ReadMessage(in, m_connection != nullptr, message);
        if (read == Read::More)
            return true;
        if (read == Read::Bad) {
            // The toolkit's server answers what it cannot handle with a failure.
            if (message.code != kIpcDisconnect)
                Answer(kIpcFail);
            return false;
        }
        m_input.erase(0, in.Used());
        m_deadline =
            std::chrono::steady_clock::now() + std::chrono::milliseconds(kIpcPeerTimeoutMs);
        if (message.code == kIpcConnect) {
            m_topic = wxString::FromUTF8(message.name);
            m_connection.reset(Accept(m_topic));
            if (!Answer(m_connection ? kIpcConnect : kIpcFail) || !m_connection)
                return false;
        } else {
            // A byte beyond the toolkit's formats is no value of its enum type.
            const wxIPCFormat format = message.format <= wxIPC_PRIVATE
                                           ? static_cast<wxIPCFormat>(message.format)
                                           : wxIPC_INVALID;
            m_busy = true;
            m_connection->OnPoke(m_topic, wxString::FromUTF8(message.name), message.data.data(),
                                 message.data.size(), format);
            m_busy = false;
        }
    }
}

bool IpcPeerTable::Add(std::unique_ptr<IpcPeer> peer)
{
    if (m_peers.size() >= kIpcMaxPeers) {
        const auto oldest = std::find_if(m_peers.begin(), m_peers.end(),
                                         [](const auto& held) { return !held->IsBusy(); });
        if (oldest == m_peers.end())
            return false;
        m_peers.erase(oldest);
    }
    m_peers.push_back(std::move(peer));
    return true;
}

void IpcPeerTable::Drop(const IpcPeer& peer)
{
    const auto found = std::find_if(m_peers.begin(), m_peers.end(),
                                    [&peer](const auto& held) { return held.get() == &peer; });
    if (found != m_peers.end())
        m_peers.erase(found);
}

void IpcPeerTable::DropLate(std::chrono::steady_clock::time_point now)
{
    m_peers.erase(std::remove_if(m_peers.begin(), m_peers.end(),
                                 [now](const auto& peer) {
                                     return !peer->IsBusy() && peer->GetDeadline() <= now;
                                 }),
                  m_peers.end());
}
