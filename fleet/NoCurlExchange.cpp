#include "fleet/HttpExchange.h"
#include "store/MeasurementStore.h"
#include "text/Format.h"

namespace pallax {

// A build without libcurl.

struct HttpExchange::Impl {};

HttpExchange::HttpExchange(const StoreAddress& address, Patience /*patience*/) {
    throw StoreFailure(formatText("This build of Pallax cannot reach %@: it was made without "
                                  "libcurl.",
                                  {address.text()}));
}

HttpExchange::~HttpExchange() = default;

int HttpExchange::post(const std::string& /*parameters*/, const Give& /*give*/,
                       const Take& /*take*/) {
    return 0;
}

} // namespace pallax
