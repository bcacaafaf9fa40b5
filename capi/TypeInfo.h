#pragma once
// What the platform's type library would tell its dispatch layer about cTavixGraph: which dispatch
// ids exist, how each is invoked and how many arguments it takes. A call that does not fit is
// refused at the boundary, before the class runs, with the dispatch layer's own status.
#include <cstdint>

#include "core/Dispatch.h"

namespace kg::capi {

// Throws Failure with KG_E_MEMBERNOTFOUND (Error 438) or KG_E_BADPARAMCOUNT (Error 450) when the
// call does not fit the member of `object`; objects other than cTavixGraph are not checked here.
void checkCall(const Object& object, DispId id, uint16_t flags, uint32_t argc);

}  // namespace kg::capi
