// The launcher on a 200% display: at 192 dots per inch its frame and every button take
// twice the physical pixels they take at 96, drawn from the pictures rendered at twice
// their size.
#include "support/ProbeRun.h"
#include "support/StandinDir.h"

#include <gtest/gtest.h>

#include <windows.h>

#include <memory>
#include <vector>

namespace {

// The resolution a Windows program reads once, when it starts (Wine: the same key).
class ScopedLogPixels
{
public:
    explicit ScopedLogPixels(DWORD dpi)
    {
        DWORD size = sizeof(m_old);
        m_had = RegGetValueW(HKEY_CURRENT_USER, kKey, L"LogPixels", RRF_RT_REG_DWORD, nullptr,
                             &m_old, &size) == ERROR_SUCCESS;
        RegSetKeyValueW(HKEY_CURRENT_USER, kKey, L"LogPixels", REG_DWORD, &dpi, sizeof(dpi));
    }
    ~ScopedLogPixels()
    {
        if (m_had)
            RegSetKeyValueW(HKEY_CURRENT_USER, kKey, L"LogPixels", REG_DWORD, &m_old,
                            sizeof(m_old));
        else
            RegDeleteKeyValueW(HKEY_CURRENT_USER, kKey, L"LogPixels");
    }

private:
    static constexpr const wchar_t* kKey = L"Control Panel\\Desktop";
    DWORD m_old = 0;
    bool m_had = false;
};

// The frame's client area and its button windows, in physical pixels.
std::vector<SIZE> Measure(ProbeRun& run)
{
    const HWND frame = reinterpret_cast<HWND>(uintptr_t(run.Window()));
    std::vector<SIZE> sizes;
    if (!frame)
        return sizes;
    RECT client = {};
    GetClientRect(frame, &client);
    sizes.push_back({client.right, client.bottom});
    EnumChildWindows(
        frame,
        [](HWND child, LPARAM list) -> BOOL {
            wchar_t name[64] = {};
            GetWindowTextW(child, name, 64);
            RECT rect = {};
            GetClientRect(child, &rect);
            if (name[0])
                reinterpret_cast<std::vector<SIZE>*>(list)->push_back({rect.right, rect.bottom});
            return TRUE;
        },
        reinterpret_cast<LPARAM>(&sizes));
    return sizes;
}

TEST(DisplayScaleTest, FrameAndButtonsTakeTwiceThePixelsAt192Dpi)
{
    StandinDir install({"Quenta Print Studio.exe"});
    std::vector<SIZE> at96, at192;
    {
        ProbeRun run(install.Path(), {});
        ASSERT_TRUE(run.WaitForShown(60000)) << "the frame at 96 dpi";
        at96 = Measure(run);
    }
    {
        std::unique_ptr<ScopedLogPixels> dpi = std::make_unique<ScopedLogPixels>(192);
        ProbeRun run(install.Path(), {});
        ASSERT_TRUE(run.WaitForShown(60000)) << "the frame at 192 dpi";
        // Read by now: later programs see the old value again.
        dpi.reset();
        at192 = Measure(run);
    }
    ASSERT_GE(at96.size(), 8u) << "the frame and its seven buttons";
    EXPECT_EQ(at96[0].cx, 564);
    ASSERT_EQ(at192.size(), at96.size());
    for (size_t i = 0; i < at96.size(); ++i) {
        SCOPED_TRACE(i);
        EXPECT_EQ(at192[i].cx, 2 * at96[i].cx);
        EXPECT_EQ(at192[i].cy, 2 * at96[i].cy);
    }
}

} // namespace
