#pragma once
// The two adapters between our objects and the C surface's:
//   - a kg::Object handed to the host becomes a KGObject whose Invoke calls the object's invoke;
//   - a host's KGObject handed to the component becomes a kg::Object, so the component reaches it
//     by name through the same late-bound calls as its own objects, and its failures come back as
//     kg::Error with the host's number and description.
// Each direction unwraps the other's wrapper, so an object keeps its identity across a round trip.
#include <string>

#include "core/Dispatch.h"
#include "karstgraph/karstgraph.h"

namespace kg::capi {

// A KGObject with one reference for the caller; null for Nothing. A wrapped host object is
// returned as itself (one more reference).
KGObject* exportObject(const Ref<Object>& object);
// The object behind a KGObject; null for NULL. A host's object is wrapped and named `name` in
// messages.
Ref<Object> importObject(KGObject* object, const std::string& name);

// Objects handed out through the C surface and still alive: our KGObjects and class objects.
long liveHandles() noexcept;
void handleCreated() noexcept;
void handleDestroyed() noexcept;

// AddRef and Release of a handle with an atomic `refs`: the last Release deletes it.
template <class Handle>
uint32_t addRefHandle(Handle& handle)
{
    return ++handle.refs;
}
template <class Handle>
uint32_t releaseHandle(Handle& handle)
{
    const uint32_t left = --handle.refs;
    if (left == 0) {
        delete &handle;
        handleDestroyed();
    }
    return left;
}

}  // namespace kg::capi
