#include "web/HttpServer.h"

namespace pallax {

// A build without libmicrohttpd.

struct HttpServer::Impl {};

HttpServer::HttpServer(std::unique_ptr<Impl> impl) : _impl(std::move(impl)) {}

HttpServer::~HttpServer() = default;

Result<std::unique_ptr<HttpServer>, HostError> HttpServer::start(Setup /*setup*/) {
    return HostError{"This build of Pallax cannot serve pages: it was made without libmicrohttpd."};
}

void HttpServer::publish(std::shared_ptr<const std::string> /*text*/) {}

std::size_t HttpServer::streams() const {
    return 0;
}

} // namespace pallax
