#pragma once
// The demo's own objects as the component sees them: a KGObject whose table of functions leads to a
// C++ class. Members are found by name without regard to case; their ids are their places in the
// list the class gives (from 1). Objects are counted and live on the user-interface thread only.
#include <cstdint>
#include <string>
#include <vector>

#include "apps/demo/ComponentLibrary.h"

namespace kg::demo {

// The run-time library's error numbers that the host's objects raise.
namespace vberr {
constexpr int32_t SubscriptOutOfRange = 9;
constexpr int32_t ControlArrayElement = 340;  // "Control array element 'n' doesn't exist"
constexpr int32_t ObjectUnloaded = 364;
constexpr int32_t InvalidArrayIndex = 381;
}  // namespace vberr

class HostObject : public KGObject {
public:
    HostObject(const ComponentApi& api, std::vector<const char*> members);
    HostObject(const HostObject&) = delete;
    HostObject& operator=(const HostObject&) = delete;

    // The object as handed to the component; the caller's reference is the one made at creation.
    KGObject* object() { return this; }

    // Fills `error` and returns KG_E_EXCEPTION, as a member that raised error `number` does.
    static int32_t raise(KGErrorInfo* error, int32_t number, const std::string& description);

protected:
    virtual ~HostObject() = default;

    // One member call: `id` is a place in the member list (from 1), already checked.
    virtual int32_t call(int32_t id, KGVariant* args, uint32_t argc, KGVariant* result, KGErrorInfo* error) = 0;

    int32_t returnLong(KGVariant* result, int32_t value) const;
    int32_t returnDouble(KGVariant* result, uint16_t vt, double value) const;
    int32_t returnString(KGVariant* result, const std::string& text) const;
    int32_t returnObject(KGVariant* result, KGObject* object) const;

    // An index argument as the run-time library converts one; false when it is not a number.
    static bool wholeNumber(const KGVariant& v, int32_t& out);

    // A copy: the component may keep an object longer than the host keeps its handle on the library.
    const ComponentApi api_;

private:
    static uint32_t addRef(KGObject* self);
    static uint32_t release(KGObject* self);
    static int32_t idOfName(KGObject* self, const char* name, int32_t* id);
    static int32_t invoke(KGObject* self, int32_t id, uint16_t flags, KGVariant* args, uint32_t argc,
                          KGVariant* result, KGErrorInfo* error);
    static const KGObjectVtbl kVtbl;

    std::vector<const char*> members_;
    uint32_t refs_ = 1;
};

}  // namespace kg::demo
