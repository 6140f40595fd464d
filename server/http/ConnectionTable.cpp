#include "server/http/ConnectionTable.h"

#include <utility>

#include "server/http/HttpConnection.h"

namespace ktr::server {

bool ConnectionTable::add(const std::shared_ptr<HttpConnection>& connection) {
    std::vector<std::shared_ptr<HttpConnection>> leaving;
    bool fits = true;
    {
        const std::lock_guard<std::mutex> lock(mutex_);
        const std::string& address = connection->peer();
        // What comes through a socket in the file system is a proxy, which counts its own clients.
        const auto known = perAddress_.find(address);
        if (!address.empty() && known != perAddress_.end() && known->second >= limits_.connectionsPerAddress) {
            leaving.push_back(takeLongestWaiting(&address));
            fits = leaving.back() != nullptr;
        }
        if (fits && entries_.size() >= limits_.connections) {
            leaving.push_back(takeLongestWaiting(nullptr));
            fits = leaving.back() != nullptr;
        }
        if (fits) {
            entries_[connection.get()] = {connection, address, false, ++events_};
            ++perAddress_[address];
        }
    }
    ++(fits ? counters_->accepted : counters_->turnedAway);
    for (const auto& other : leaving) {
        if (other) {
            ++counters_->gaveWay;
            other->close();
        }
    }
    return fits;
}

std::shared_ptr<HttpConnection> ConnectionTable::takeLongestWaiting(const std::string* address) {
    auto longest = entries_.end();
    for (auto entry = entries_.begin(); entry != entries_.end(); ++entry) {
        const bool counts = !entry->second.answering && (address == nullptr || entry->second.address == *address);
        if (counts && (longest == entries_.end() || entry->second.since < longest->second.since)) {
            longest = entry;
        }
    }
    if (longest == entries_.end()) {
        return nullptr;
    }
    auto connection = std::move(longest->second.connection);
    if (--perAddress_[longest->second.address] == 0) {
        perAddress_.erase(longest->second.address);
    }
    entries_.erase(longest);
    return connection;
}

void ConnectionTable::remove(const HttpConnection& connection) {
    std::shared_ptr<HttpConnection> last;
    const std::lock_guard<std::mutex> lock(mutex_);
    const auto entry = entries_.find(&connection);
    if (entry == entries_.end()) {
        return;
    }
    if (--perAddress_[entry->second.address] == 0) {
        perAddress_.erase(entry->second.address);
    }
    last = std::move(entry->second.connection);
    entries_.erase(entry);
}

void ConnectionTable::setAnswering(const HttpConnection& connection, bool answering) {
    const std::lock_guard<std::mutex> lock(mutex_);
    if (const auto entry = entries_.find(&connection); entry != entries_.end()) {
        entry->second.answering = answering;
        entry->second.since = ++events_;
    }
}

std::vector<std::shared_ptr<HttpConnection>> ConnectionTable::all() const {
    const std::lock_guard<std::mutex> lock(mutex_);
    std::vector<std::shared_ptr<HttpConnection>> connections;
    for (const auto& [key, entry] : entries_) {
        connections.push_back(entry.connection);
    }
    return connections;
}

std::size_t ConnectionTable::size() const {
    const std::lock_guard<std::mutex> lock(mutex_);
    return entries_.size();
}

}  // namespace ktr::server
