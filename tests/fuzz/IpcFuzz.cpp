// libFuzzer target: the IPC server's peers without sockets. The input is a script: peers
// connect, send pieces of bytes or long runs of one byte, end their streams, run late; each
// poke may run more of the script nested inside it, as a dialog's event loop in OnPoke does.
// Every limit is checked as it could be broken, and each peer's outcome against the same
// bytes handed to a fresh peer in one piece.
#include "platform/unix/IpcPeer.h"

#include <wx/init.h>
#include <wx/log.h>

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <deque>

namespace {

void Check(bool holds, const char* what)
{
    if (!holds) {
        std::fprintf(stderr, "IPC peer: %s\n", what);
        std::abort();
    }
}

// What one peer was given and what came of it.
struct Record
{
    bool answersFail = false;
    std::string sent;
    bool ended = false;
    std::vector<std::string> events;
    bool accepted = false, confirmed = false, failed = false;
    IpcPeer::State final = IpcPeer::State::Waiting;
};

class Script
{
public:
    Script(const std::uint8_t* data, std::size_t size) : m_data(data), m_size(size) {}
    bool Done() const { return m_at == m_size; }
    std::uint8_t Byte() { return Done() ? 0 : m_data[m_at++]; }
    std::size_t Number(int bytes)
    {
        std::size_t value = 0;
        for (int i = 0; i < bytes; ++i)
            value |= std::size_t(Byte()) << (8 * i);
        return value;
    }
    std::string Bytes(std::size_t count)
    {
        count = std::min(count, m_size - m_at);
        m_at += count;
        return std::string(reinterpret_cast<const char*>(m_data) + m_at - count, count);
    }

private:
    const std::uint8_t* m_data;
    std::size_t m_size, m_at = 0;
};

class Driver;

class FuzzPeer : public IpcPeer
{
public:
    FuzzPeer(Record& record, Driver* driver) : m_record(record), m_driver(driver) {}
    ~FuzzPeer() override;
    Record& m_record;
    Driver* const m_driver; // null: no script runs inside its pokes
    bool m_watched = true;

protected:
    wxConnectionBase* Accept(const wxString& topic) override;
    bool Answer(IpcCode code) override
    {
        Check(!m_record.failed, "an answer after a failure");
        Check(code == kIpcFail || (code == kIpcConnect && m_record.accepted && !m_record.confirmed),
              "a conversation confirmed that was not accepted");
        m_record.failed = code == kIpcFail;
        m_record.confirmed = code == kIpcConnect;
        m_record.events.push_back("answer " + std::to_string(code));
        return !m_record.answersFail;
    }
};

class FuzzConnection : public IpcConnection
{
public:
    explicit FuzzConnection(FuzzPeer& peer) : m_peer(peer) {}
    bool OnPoke(const wxString& topic, const wxString& item, const void* data, std::size_t size,
                wxIPCFormat format) override;

private:
    FuzzPeer& m_peer;
};

// Runs the script against a table of peers, as the server's event loop would.
class Driver
{
public:
    explicit Driver(Script& script) : m_script(script) {}

    void Run()
    {
        while (!m_script.Done())
            Step();
        for (FuzzPeer* peer : std::vector<FuzzPeer*>(m_live)) {
            Check(peer->m_watched, "a peer left unwatched after its poke");
            Check(Deliver(*peer, {}) == IpcPeer::Step::Drop, "a peer outlived its stream");
            m_table.Drop(*peer);
        }
        Check(m_table.Size() == 0 && m_live.empty(), "a peer held after every stream ended");
        for (const Record& record : m_records)
            CheckAgainstOnePiece(record);
    }

    // Runs a few steps of the script inside a poke.
    void Nested()
    {
        if (m_depth == kIpcMaxPeers + 4)
            return;
        ++m_depth;
        for (int count = m_script.Byte() % 4; count > 0; --count)
            Step();
        --m_depth;
    }

    void Forget(FuzzPeer& peer) { m_live.erase(std::find(m_live.begin(), m_live.end(), &peer)); }

private:
    void Step()
    {
        const std::uint8_t op = m_script.Byte() % 5;
        if (op == 0) {
            m_records.push_back({});
            m_records.back().answersFail = m_script.Byte() & 1;
            auto peer = std::make_unique<FuzzPeer>(m_records.back(), this);
            m_live.push_back(peer.get());
            m_table.Add(std::move(peer));
            Check(m_table.Size() <= kIpcMaxPeers, "more peers held than allowed");
            return;
        }
        if (op == 4) {
            m_table.DropLate(std::chrono::steady_clock::now() + std::chrono::hours(1));
            return;
        }
        const std::uint8_t pick = m_script.Byte();
        FuzzPeer* peer = m_live.empty() ? nullptr : m_live[pick % m_live.size()];
        std::string bytes;
        if (op == 1)
            bytes = m_script.Bytes(m_script.Number(2));
        else if (op == 2)
            bytes.assign(m_script.Number(3) % (kIpcMaxMessageSize + 2), char(m_script.Byte()));
        if (peer && peer->m_watched && (op == 3 || !bytes.empty()) &&
            Deliver(*peer, bytes) == IpcPeer::Step::Drop)
            m_table.Drop(*peer);
    }

    IpcPeer::Step Deliver(FuzzPeer& peer, const std::string& bytes)
    {
        Record& record = peer.m_record;
        const bool busy = peer.IsBusy();
        const std::size_t held = peer.GetHeldSize(), sent = record.sent.size();
        record.sent += bytes;
        record.ended = bytes.empty();
        const IpcPeer::Step step = peer.Receive(bytes.data(), bytes.size());
        if (busy) {
            Check(step != IpcPeer::Step::Drop, "a peer dropped inside its own poke");
            Check(peer.GetHeldSize() <= std::max(held, kIpcMaxMessageSize),
                  "input beyond a message held during a poke");
            if (step == IpcPeer::Step::Pause) {
                // No more is read: neither this piece (past the limit) nor any later one.
                record.sent.resize(sent);
                record.ended = true;
                peer.m_watched = false;
            }
            return step;
        }
        Check(step != IpcPeer::Step::Pause, "a pause outside a poke");
        Check((step == IpcPeer::Step::Drop) == (peer.GetState() == IpcPeer::State::Closed),
              "a drop and the peer's state disagree");
        Check(step == IpcPeer::Step::Drop || peer.GetHeldSize() < kIpcMaxMessageSize,
              "a message's worth of input held and not handled");
        return step;
    }

    // The same bytes in one piece, with nothing nested, end the same way.
    static void CheckAgainstOnePiece(const Record& record)
    {
        Record again;
        again.answersFail = record.answersFail;
        {
            FuzzPeer peer(again, nullptr);
            IpcPeer::Step step = IpcPeer::Step::Keep;
            if (!record.sent.empty())
                step = peer.Receive(record.sent.data(), record.sent.size());
            if (record.ended && step == IpcPeer::Step::Keep)
                peer.Receive(nullptr, 0);
        }
        Check(again.events == record.events && again.final == record.final,
              "the bytes in pieces and in one piece end differently");
    }

    Script& m_script;
    IpcPeerTable m_table;
    std::deque<Record> m_records;
    std::vector<FuzzPeer*> m_live;
    std::size_t m_depth = 0;
};

FuzzPeer::~FuzzPeer()
{
    Check(!IsBusy(), "a peer deleted inside its own poke");
    m_record.final = GetState();
    Check(m_record.final != State::Open || m_record.confirmed, "open without confirmation");
    if (m_driver)
        m_driver->Forget(*this);
}

wxConnectionBase* FuzzPeer::Accept(const wxString& topic)
{
    Check(GetState() == State::Waiting && !m_record.accepted, "a second conversation");
    const std::string name = topic.utf8_string();
    Check(name.size() <= kIpcMaxNameSize, "a topic beyond its limit");
    m_record.events.push_back("topic " + name);
    m_record.accepted = name == "IPC START";
    return m_record.accepted ? new FuzzConnection(*this) : nullptr;
}

bool FuzzConnection::OnPoke(const wxString& topic, const wxString& item, const void* data,
                            std::size_t size, wxIPCFormat format)
{
    Check(m_peer.IsBusy() && m_peer.GetState() == IpcPeer::State::Open && m_peer.m_record.confirmed,
          "a poke outside a confirmed conversation");
    Check(topic == "IPC START", "a poke on another topic");
    const std::string name = item.utf8_string();
    Check(name.size() <= kIpcMaxNameSize, "an item beyond its limit");
    Check(size <= kIpcMaxPokeSize && (data || !size), "poke data beyond its limit");
    wxString text;
    ReadPokeText(data, size, format, text);
    m_peer.m_record.events.push_back("poke " + name + '\0' + std::to_string(format) + '\0' +
                                     std::string(static_cast<const char*>(data), size));
    if (m_peer.m_driver)
        m_peer.m_driver->Nested();
    return true;
}

} // namespace

extern "C" int LLVMFuzzerInitialize(int*, char***)
{
    wxInitialize();
    wxLog::EnableLogging(false);
    return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    Script script(data, size);
    Driver(script).Run();
    return 0;
}
