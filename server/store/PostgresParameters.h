#pragma once

#include <array>
#include <string>

namespace ktr::server {

/// How a connection to a PostgreSQL server is made: what the address says itself comes later, and holds. A peer that
/// says nothing any more is given up. For the library's calls; the address outlives it. A value.
struct PostgresParameters {
    explicit PostgresParameters(const std::string& address)
        : values{"5", "15000", "10", "5", "3", "ktr-service", address.c_str(), nullptr} {}

    std::array<const char*, 8> names{
        "connect_timeout",  "tcp_user_timeout",          "keepalives_idle", "keepalives_interval",
        "keepalives_count", "fallback_application_name", "dbname",          nullptr};
    std::array<const char*, 8> values;
};

}  // namespace ktr::server
