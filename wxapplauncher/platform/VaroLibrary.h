// Loads the instrument maker's shared library once per process: from the
// launcher's own directory, else by name from the system's library path.
#pragma once

class VaroLibrary
{
public:
    // The process-wide library; it is loaded on the first call and never unloaded,
    // because the library keeps calling back into the program until it ends.
    static const VaroLibrary& Get();

    bool IsLoaded() const { return m_handle != nullptr; }

    // The address of an exported symbol, or null when it or the library is missing.
    void* Symbol(const char* name) const;

private:
    VaroLibrary();

    void* m_handle;
};
