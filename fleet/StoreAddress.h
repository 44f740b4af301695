#pragma once

#include <cstdint>
#include <string>

namespace pallax {

/// A database on a server: "clickhouse://HOST[:PORT]/DATABASE".
struct StoreAddress {
    std::string host; ///< a name or an address, in brackets if it has colons
    std::uint16_t port = 0;
    std::string database;

    /// "clickhouse://host:8123/measurements", for sentences.
    std::string text() const;
    /// "https://host:8443": the port of ClickHouse for HTTPS means HTTPS.
    std::string httpAddress() const;
};

/// Whether what names a store is meant as an address, and not as a file.
bool isStoreAddress(const std::string& url);

/// Throws StoreFailure for what is not such an address. Its sentence does not repeat a password.
StoreAddress parseStoreAddress(const std::string& url);

} // namespace pallax
