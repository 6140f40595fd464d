#pragma once

#include <cstddef>
#include <map>
#include <memory>
#include <mutex>
#include <string>
#include <utility>
#include <vector>

#include "server/http/EdgeCounters.h"
#include "server/http/HttpLimits.h"

namespace ktr::server {

class HttpConnection;

/// The connections that are open, bounded in all and by address. Where there is no room, whoever has waited longest
/// without giving us anything to do has to go: silent and dripping clients, however many, give way to one that speaks.
/// Any thread.
class ConnectionTable {
  public:
    ConnectionTable(const HttpLimits& limits, std::shared_ptr<EdgeCounters> counters)
        : limits_(limits), counters_(std::move(counters)) {}

    /// False when there is no room, since every connection in the way is being answered. May close another one.
    bool add(const std::shared_ptr<HttpConnection>& connection);
    void remove(const HttpConnection& connection);
    /// While a connection is being answered it does not give way.
    void setAnswering(const HttpConnection& connection, bool answering);
    std::vector<std::shared_ptr<HttpConnection>> all() const;
    std::size_t size() const;

  private:
    struct Entry {
        std::shared_ptr<HttpConnection> connection;
        std::string address;
        bool answering = false;
        std::size_t since = 0;  ///< in the order of events
    };
    /// Takes the one out that waits longest, of an address or, with none, of all; none when nobody waits.
    std::shared_ptr<HttpConnection> takeLongestWaiting(const std::string* address);

    const HttpLimits limits_;
    const std::shared_ptr<EdgeCounters> counters_;
    mutable std::mutex mutex_;
    std::map<const HttpConnection*, Entry> entries_;
    std::map<std::string, std::size_t> perAddress_;
    std::size_t events_ = 0;
};

}  // namespace ktr::server
