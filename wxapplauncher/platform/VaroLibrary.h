// Loads the instrument maker's library once per process: from the launcher's
// own directory, else by name from the system's library path.
#pragma once

class VaroLibrary
{
public:
    // The process-wide library; it is loaded on the first call and never unloaded,
    // because the library keeps calling back into the program until it ends.
    static const VaroLibrary& Get();

    bool IsLoaded() const { return m_handle != nullptr; }

    // The function the library exports under `ordinal`, or null when it or the
    // library is missing. Where libraries have no ordinals, the library exports
    // the client's functions by name and the ordinals map to those names.
    void* Function(int ordinal) const;

    // The address of an exported name, or null when it or the library is missing.
    void* Symbol(const char* name) const;

private:
    VaroLibrary();

    void* m_handle; // the system's handle of the loaded library
};
