// The check on what a peer pokes, shared by the IPC servers of both systems.
#include "platform/Ipc.h"

#include <gtest/gtest.h>

#include <string>

namespace {

// What a peer pokes counts only as bounded, valid text, up to its first NUL.
TEST(IpcTest, PokeTextOnlyFromBoundedValidText)
{
    const std::string longText = "LaunchPad$" + std::string(2000, 'p') + "*ü.html";
    const struct
    {
        std::string bytes;
        wxIPCFormat format;
        bool accepted;
        std::string text;
    } pokes[] = {
        {longText + '\0', wxIPC_UTF8TEXT, true, longText},
        {std::string("Exit\0more", 9), wxIPC_TEXT, true, "Exit"},
        {"Raise\xff\xfe", wxIPC_UTF8TEXT, false, ""},
        {std::string("R\0\0\0\0\0\0\0", 8), wxIPC_UNICODETEXT, false, ""},
        {std::string(64 * 1024 + 1, 'x'), wxIPC_TEXT, false, ""},
    };
    for (const auto& poke : pokes) {
        SCOPED_TRACE(testing::Message() << &poke - pokes);
        wxString text = "stale";
        EXPECT_EQ(ReadPokeText(poke.bytes.data(), poke.bytes.size(), poke.format, text),
                  poke.accepted);
        EXPECT_EQ(text.utf8_string(), poke.text);
    }
}

} // namespace
