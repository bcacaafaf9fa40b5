#pragma once
// The test stand that stands in for a host's own library objects: the options the host set with
// KGSetHostOption, and the stand's factory made with them.

namespace kg::capi {

// Installs the test stand's factory into the services in use when they have none.
void installStandUnlessHostHasOne();

}  // namespace kg::capi
