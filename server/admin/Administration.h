#pragma once

#include <cstdint>
#include <optional>
#include <ostream>
#include <string>
#include <vector>

#include "server/http/ListeningSocket.h"
#include "server/store/Store.h"

namespace ktr::server {

/// Somebody who is added, and what is wanted with it at once. A value.
struct Newcomer {
    std::string name;
    std::vector<std::string> handles;  ///< by which friends ask
    std::string key;                   ///< with which the phone seals its messages; empty: it does not
    std::vector<std::string> friends;  ///< whom the newcomer sees, and who see the newcomer, exactly
    std::string ktr;                   ///< the folder of a configuration with which ktr asks; empty: none
};

/// The commands of `ktr-service`. Each writes what it did to `out`, never a position, and gives a sentence when it
/// could not be done, else an empty text. One thread.
class Administration {
  public:
    Administration(std::string folder, std::int64_t now, std::ostream& out)
        : folder_(std::move(folder)), now_(now), out_(out) {}

    /// `store`: the address of a PostgreSQL server; empty: a file in the folder.
    std::string init(const std::string& host, int port, const std::string& store);
    /// A person with a phone: what to type into its app, with the secret that is shown once.
    std::string add(const Newcomer& who);
    /// A configuration with which ktr asks for this person, with the secret that is shown once.
    std::string reader(const std::string& name, const std::string& tokenFile);
    /// The two see each other exactly until one of them ends it.
    std::string befriend(const std::string& one, const std::string& other);
    std::string share(const std::string& owner, const std::string& viewer, const std::string& precision,
                      const std::string& until);
    /// Without a viewer: all secrets of a person.
    std::string revoke(const std::string& owner, const std::string& viewer);
    std::string setHidden(const std::string& name, bool hidden);
    std::string people();
    std::string check();
    /// Where it serves. A value.
    struct Serving {
        std::string address;             ///< for its own certificate; empty: 127.0.0.1, or none beside a socket
        ListeningSocket::Place place{};  ///< a socket for a proxy; without a path: none
    };
    /// Serves until SIGINT or SIGTERM. Where the service manager made sockets, it serves on these.
    std::string serve(const Serving& where);

  private:
    std::string addWithPhone(const std::string& name, const std::vector<std::string>& handles, const std::string& key);
    /// A new secret for ktr in that file, and the configuration that uses it.
    std::string makeReader(const std::string& name, const std::string& tokenFile, std::string& configuration);
    /// Opens the store; an empty text when it is open.
    std::string open();
    std::optional<Person> person(const std::string& name, std::string& complaint);

    const std::string folder_;
    const std::int64_t now_;
    std::ostream& out_;
    std::unique_ptr<Store> store_;
};

}  // namespace ktr::server
