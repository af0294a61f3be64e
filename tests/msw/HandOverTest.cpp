// A second Veltrona.exe against the running copy, as a file manager starts it: the whole
// path reaches Inspect, and its status says whether the hand-over worked, also when
// the running copy hangs in the middle of it.
#include "support/ProbeRun.h"
#include "support/StandinDir.h"
#include "support/StandinLog.h"

#include <gtest/gtest.h>
#include <wx/defs.h>
#include <wx/snglinst.h>
#include <wx/utils.h>

#include <windows.h>

#include <ddeml.h>

#include <thread>

namespace {

const wxString kInstance = "Zelgrave.Veltrona." + wxGetUserId();

// A DDE server on a thread of its own for the launcher's service: it accepts every
// conversation and never returns from a poke until it is destroyed.
class HungService
{
public:
    HungService()
    {
        s_release = CreateEventW(nullptr, TRUE, FALSE, nullptr);
        const HANDLE ready = CreateEventW(nullptr, TRUE, FALSE, nullptr);
        m_thread = std::thread([this, ready] {
            DWORD instance = 0;
            DdeInitializeW(&instance, Callback, APPCLASS_STANDARD, 0);
            const HSZ name =
                DdeCreateStringHandleW(instance, (kInstance + ".ipc").wc_str(), CP_WINUNICODE);
            DdeNameService(instance, name, nullptr, DNS_REGISTER);
            m_threadId = GetCurrentThreadId();
            SetEvent(ready);
            for (MSG message; GetMessageW(&message, nullptr, 0, 0) > 0;)
                DispatchMessageW(&message);
            DdeNameService(instance, name, nullptr, DNS_UNREGISTER);
            DdeFreeStringHandle(instance, name);
            DdeUninitialize(instance);
        });
        WaitForSingleObject(ready, 10000);
        CloseHandle(ready);
    }
    ~HungService()
    {
        SetEvent(s_release);
        PostThreadMessageW(m_threadId, WM_QUIT, 0, 0);
        m_thread.join();
        CloseHandle(s_release);
    }

private:
    static HDDEDATA CALLBACK Callback(UINT type, UINT, HCONV, HSZ, HSZ, HDDEDATA, ULONG_PTR,
                                      ULONG_PTR)
    {
        if (type == XTYP_CONNECT)
            return reinterpret_cast<HDDEDATA>(TRUE);
        if (type == XTYP_POKE) {
            WaitForSingleObject(s_release, INFINITE);
            return reinterpret_cast<HDDEDATA>(DDE_FACK);
        }
        return nullptr;
    }

    static inline HANDLE s_release = nullptr;
    std::thread m_thread;
    DWORD m_threadId = 0;
};

// A top-level window whose thread stops answering messages, as a hung program's does:
// every conversation's start is sent to each top-level window.
class HungWindow
{
public:
    HungWindow()
    {
        const HANDLE release = m_release = CreateEventW(nullptr, TRUE, FALSE, nullptr);
        const HANDLE ready = CreateEventW(nullptr, TRUE, FALSE, nullptr);
        m_thread = std::thread([release, ready] {
            const HWND window = CreateWindowExW(0, L"STATIC", L"Hung", WS_OVERLAPPED, 0, 0, 50, 50,
                                                nullptr, nullptr, nullptr, nullptr);
            SetEvent(ready);
            WaitForSingleObject(release, INFINITE);
            DestroyWindow(window);
        });
        WaitForSingleObject(ready, 10000);
        CloseHandle(ready);
    }
    ~HungWindow()
    {
        SetEvent(m_release);
        m_thread.join();
        CloseHandle(m_release);
    }

private:
    HANDLE m_release;
    std::thread m_thread;
};

TEST(HandOverTest, WholePathsReachInspectAndFailuresEndWithAStatus)
{
    StandinDir install({"Quenta Inspect Studio.exe"});
    const std::string log = install.Path() + "\\starts.log";
    const std::string blanks = install.Path() + "\\my profiles\\screen one.icc";
    std::string longPath = install.Path() + "\\";
    longPath += std::string(400 - 4 - longPath.size(), 'p') + ".icc";
    ASSERT_EQ(longPath.size(), 400u);
    const EnvList env = {{"VELTRONA_STANDIN_LOG", log}, {"VELTRONA_STANDIN_EXIT", "1"}};

    const int kEither = -1; // 0 or 1
    enum class First
    {
        Launcher,
        HungWindow,
        HungService,
        LockOnly
    };
    const struct
    {
        First first;
        std::string file;
        int status;
    } cases[] = {
        {First::Launcher, blanks, 0},
        {First::Launcher, longPath, 0},
        // Another program's window hangs. Starting a conversation sends to every top-level
        // window, and under Wine that waits for the hung one, so the hand-over fails there:
        // the copy still ends, and its status says what happened.
        {First::HungWindow, blanks, kEither},
        // Connected, then the poke never returns: the copy gives up at its own deadline.
        {First::HungService, blanks, 1},
        // The lock is held but nobody serves: it stops trying after its retries.
        {First::LockOnly, blanks, 1},
    };
    std::unique_ptr<ProbeRun> running;
    size_t handedOver = 0;
    for (const auto& test : cases) {
        SCOPED_TRACE(test.file.substr(0, 80) + " " + std::to_string(int(test.first)));
        std::unique_ptr<wxSingleInstanceChecker> lock;
        std::unique_ptr<HungService> hung;
        std::unique_ptr<HungWindow> hungWindow;
        if (test.first == First::HungWindow)
            hungWindow = std::make_unique<HungWindow>();
        if (test.first <= First::HungWindow && !running) {
            running = std::make_unique<ProbeRun>(install.Path(), Args{}, env);
            ASSERT_TRUE(running->WaitForShown(60000)) << "the first copy's frame";
        } else if (test.first > First::HungWindow) {
            running.reset();
            lock = std::make_unique<wxSingleInstanceChecker>(kInstance);
            ASSERT_FALSE(lock->IsAnotherRunning());
            if (test.first == First::HungService)
                hung = std::make_unique<HungService>();
        }
        ProbeRun second(install.Path(), {test.file}, env);
        // A deadline for the test, far beyond the copy's own: it must end by itself.
        const int status = second.ExitCode(30000);
        EXPECT_EQ(status, test.status == kEither ? status : test.status);
        EXPECT_TRUE(status == 0 || status == 1) << status;
        EXPECT_TRUE(second.Events("shown").empty()) << "a second copy shows nothing";
        if (status == 0) {
            const auto records = WaitForRecords(log, ++handedOver, 20000);
            ASSERT_EQ(records.size(), handedOver);
            EXPECT_EQ(records.back().args, std::vector<std::string>{test.file});
        }
    }
    EXPECT_EQ(SettledRecords(log).size(), handedOver) << "a failed hand-over opens nothing";
}

} // namespace
