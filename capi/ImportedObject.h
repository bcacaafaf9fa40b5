#pragma once
// A host's KGObject as the component reaches it: a kg::Object whose members are the host's.
#include <map>
#include <string>

#include "core/Dispatch.h"
#include "karstgraph/karstgraph.h"

namespace kg::capi {

class ImportedObject final : public Object {
public:
    // Takes a reference of its own to `object`; `name` stands for it in messages ("grid1").
    ImportedObject(KGObject* object, std::string name);
    ~ImportedObject() override;

    // Error 438 when the host's object has no such member.
    DispId idOfName(std::string_view name) const override;
    // The host's Invoke; by-reference arguments the host changed are written back into `args`.
    // A failure of the host comes back as kg::Error: KG_E_EXCEPTION with the host's number and
    // description, the dispatch failures as the errors the run-time library gives for them.
    Variant invoke(DispId id, uint16_t kind, Args& args) override;
    std::string objectName() const override { return name_; }

    KGObject* hostObject() const { return object_; }

private:
    std::string memberName(DispId id) const;

    KGObject* object_;
    std::string name_;
    mutable std::map<DispId, std::string> names_;  // members looked up so far, for messages
};

}  // namespace kg::capi
