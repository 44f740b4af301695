#include "host/Complaint.h"
#include "storing/StoreOptions.h"
#include "text/Format.h"

namespace pallax {

ExitStatus runStoreSetup(const StoreSetupOptions& options) {
    if (!isStoreAddress(options.store)) {
        complain("setup needs --into clickhouse://HOST/DATABASE; a file is made when it is loaded "
                 "into.");
        return kExitWrongUsage;
    }
    setUpStore(parseStoreAddress(options.store), options.layout);
    return kExitSuccess;
}

} // namespace pallax
