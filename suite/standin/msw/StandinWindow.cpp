#include "StandinWindow.h"
#include "Utf16.h"

#include <windows.h>

#include <cstdint>

namespace standin {

namespace {

using Lines = std::vector<std::wstring>;

LRESULT CALLBACK WindowProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam)
{
    switch (message) {
    case WM_PAINT: {
        PAINTSTRUCT paint;
        HDC dc = BeginPaint(window, &paint);
        SelectObject(dc, GetStockObject(DEFAULT_GUI_FONT));
        SetBkMode(dc, TRANSPARENT);
        if (auto* lines =
                reinterpret_cast<const Lines*>(GetWindowLongPtrW(window, GWLP_USERDATA))) {
            int y = kMargin;
            for (const std::wstring& line : *lines) {
                TextOutW(dc, kMargin, y, line.c_str(), static_cast<int>(line.size()));
                y += kLineHeight;
            }
        }
        EndPaint(window, &paint);
        return 0;
    }
    case WM_DESTROY:
        PostQuitMessage(0);
        return 0;
    default:
        return DefWindowProcW(window, message, wParam, lParam);
    }
}

void WriteReadyFile(const std::string& readyFile, HWND window)
{
    const std::wstring path = Utf16(readyFile);
    const std::wstring temporary = path + L".tmp";
    HANDLE file = CreateFileW(temporary.c_str(), GENERIC_WRITE, 0, nullptr, CREATE_ALWAYS,
                              FILE_ATTRIBUTE_NORMAL, nullptr);
    if (file == INVALID_HANDLE_VALUE)
        return;
    const std::string id = std::to_string(reinterpret_cast<std::uintptr_t>(window)) + "\n";
    DWORD written = 0;
    const bool whole =
        WriteFile(file, id.data(), static_cast<DWORD>(id.size()), &written, nullptr) &&
        written == id.size();
    if (CloseHandle(file) && whole)
        MoveFileExW(temporary.c_str(), path.c_str(), MOVEFILE_REPLACE_EXISTING);
    else
        DeleteFileW(temporary.c_str());
}

} // namespace

int RunWindow(const std::string& baseName, const std::vector<std::string>& args,
              const std::string& readyFile)
{
    Lines lines{Utf16(baseName)};
    if (args.empty())
        lines.push_back(L"(no arguments)");
    for (const std::string& arg : args) {
        if (static_cast<int>(lines.size()) == kMaxLines) {
            lines.push_back(L"...");
            break;
        }
        lines.push_back(L"[" + Utf16(arg) + L"]");
    }

    const WindowIdentity identity = IdentityFor(baseName);
    const std::wstring className = Utf16(identity.wmClass);
    HINSTANCE instance = GetModuleHandleW(nullptr);
    WNDCLASSEXW windowClass = {};
    windowClass.cbSize = sizeof(windowClass);
    windowClass.lpfnWndProc = WindowProc;
    windowClass.hInstance = instance;
    windowClass.hCursor = LoadCursorW(nullptr, reinterpret_cast<LPCWSTR>(IDC_ARROW));
    windowClass.hbrBackground = reinterpret_cast<HBRUSH>(COLOR_WINDOW + 1);
    windowClass.lpszClassName = className.c_str();
    if (RegisterClassExW(&windowClass) == 0)
        return 1;

    RECT frame = {0, 0, kWidth, kMargin * 2 + kLineHeight * static_cast<LONG>(lines.size())};
    AdjustWindowRectEx(&frame, WS_OVERLAPPEDWINDOW, FALSE, 0);
    HWND window =
        CreateWindowExW(0, className.c_str(), Utf16(identity.title).c_str(), WS_OVERLAPPEDWINDOW,
                        CW_USEDEFAULT, CW_USEDEFAULT, frame.right - frame.left,
                        frame.bottom - frame.top, nullptr, nullptr, instance, nullptr);
    if (window == nullptr)
        return 1;
    SetWindowLongPtrW(window, GWLP_USERDATA, reinterpret_cast<LONG_PTR>(&lines));
    ShowWindow(window, SW_SHOWNORMAL);
    UpdateWindow(window);
    if (!readyFile.empty())
        WriteReadyFile(readyFile, window);

    MSG message;
    while (GetMessageW(&message, nullptr, 0, 0) > 0) {
        TranslateMessage(&message);
        DispatchMessageW(&message);
    }
    return 0;
}

} // namespace standin
