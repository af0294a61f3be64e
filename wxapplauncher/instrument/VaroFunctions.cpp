#include "instrument/VaroFunctions.h"

#include "platform/VaroLibrary.h"

namespace {

struct VaroOrdinal
{
    int ordinal;
    const char* symbol;
};

const VaroOrdinal kOrdinals[] = {
    {18, "VaroRegisterCallback"}, {14, "VaroCheckInstrument"}, {23, "VaroCheckTableMount"},
    {11, "VaroSetOption"},        {12, "VaroGetOption"},       {5, "VaroMeasure"},
};

template <typename Function> bool Resolve(int ordinal, Function& function)
{
    const char* symbol = VaroSymbolForOrdinal(ordinal);
    // dlsym hands out object pointers; POSIX guarantees they convert to functions.
    function = reinterpret_cast<Function>(VaroLibrary::Get().Symbol(symbol));
    return function != nullptr;
}

bool ResolveAll(VaroFunctions& functions)
{
    return Resolve(18, functions.registerCallback) && Resolve(14, functions.checkInstrument) &&
           Resolve(23, functions.checkTableMount) && Resolve(11, functions.setOption) &&
           Resolve(12, functions.getOption) && Resolve(5, functions.measure);
}

} // namespace

const char* VaroSymbolForOrdinal(int ordinal)
{
    for (const VaroOrdinal& entry : kOrdinals)
        if (entry.ordinal == ordinal)
            return entry.symbol;
    return nullptr;
}

const VaroFunctions* VaroFunctions::Get()
{
    static VaroFunctions functions;
    static const bool complete = ResolveAll(functions);
    return complete ? &functions : nullptr;
}
