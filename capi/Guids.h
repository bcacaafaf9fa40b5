#pragma once
// The C surface's KGGuid and the component's Guid hold the same fields.
#include "requests/cTavixGraph.h"
#include "karstgraph/karstgraph.h"

namespace kg::capi {

inline Guid toGuid(const KGGuid& g)
{
    Guid out{g.Data1, g.Data2, g.Data3, {}};
    for (int i = 0; i < 8; ++i) out.data4[i] = g.Data4[i];
    return out;
}

inline KGGuid toKGGuid(const Guid& g)
{
    KGGuid out{g.data1, g.data2, g.data3, {}};
    for (int i = 0; i < 8; ++i) out.Data4[i] = g.data4[i];
    return out;
}

}  // namespace kg::capi
