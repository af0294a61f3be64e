#include "instrument/VaroFunctions.h"

#include "platform/VaroLibrary.h"

namespace {

template <typename Function> bool Resolve(int ordinal, Function& function)
{
    // The library hands out object pointers; both systems let them convert to functions.
    function = reinterpret_cast<Function>(VaroLibrary::Get().Function(ordinal));
    return function != nullptr;
}

bool ResolveAll(VaroFunctions& functions)
{
    return Resolve(18, functions.registerCallback) && Resolve(14, functions.checkInstrument) &&
           Resolve(23, functions.checkTableMount) && Resolve(11, functions.setOption) &&
           Resolve(12, functions.getOption) && Resolve(5, functions.measure);
}

} // namespace

const VaroFunctions* VaroFunctions::Get()
{
    static VaroFunctions functions;
    static const bool complete = ResolveAll(functions);
    return complete ? &functions : nullptr;
}
