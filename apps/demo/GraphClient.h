#pragma once
// The host's side of cTavixGraph: the library loaded, the class created by its programmatic name
// (registered the first time, as the host's installer would), the source form handed over and the
// requests invoked by dispatch id. Every failure comes back as the error number and description
// the component reported.
#include <cstdint>
#include <string>

#include "apps/demo/ComponentLibrary.h"

namespace kg::demo {

struct Outcome {
    bool ok = false;
    int32_t number = 0;       // the error number (the status itself when the component gave none)
    std::string description;

    // "Error N: description", N as a signed decimal.
    std::string errorText() const;
};

class GraphClient {
public:
    GraphClient() = default;
    GraphClient(const GraphClient&) = delete;
    GraphClient& operator=(const GraphClient&) = delete;
    ~GraphClient();

    // Loads the library at `libraryPath` and creates KarstGraph.cTavixGraph; when the class is not
    // registered yet, registers it and tries once more.
    Outcome connect(const std::string& libraryPath);
    bool isConnected() const { return graph_ != nullptr; }
    // Whether connect had to register the class.
    bool registered() const { return registered_; }
    // The library whose class object made the graph: the registration may name another copy.
    const std::string& servingLibrary() const { return serving_.path(); }
    // The loaded library's entry points, for the host's own objects.
    const ComponentApi& api() const { return loaded_.api(); }

    // A test stand option of the serving library (KGSetHostOption).
    Outcome setHostOption(const char* key, const std::string& value);
    // SourceForm := form (a property put; the component keeps its own reference).
    Outcome setSourceForm(KGObject* form);
    // A request without arguments.
    Outcome request(int32_t dispid);
    // A grid request: lNumSeries and vTotal.
    Outcome request(int32_t dispid, int32_t numSeries, double total);

private:
    Outcome invoke(int32_t dispid, uint16_t flags, KGVariant* args, uint32_t argc);
    Outcome lastError(const ComponentApi& api, int32_t status, const std::string& what) const;

    ComponentLibrary loaded_;
    ComponentLibrary serving_;
    KGObject* graph_ = nullptr;
    bool registered_ = false;
};

}  // namespace kg::demo
