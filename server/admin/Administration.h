#pragma once

#include <cstdint>
#include <optional>
#include <ostream>
#include <string>
#include <vector>

#include "server/answers/PhoneSetUp.h"
#include "server/http/ListeningSocket.h"
#include "server/store/Store.h"

namespace ktr::server {

/// Somebody who is added, and what is wanted with it at once. A value.
struct Newcomer {
    std::string name;
    std::vector<std::string> handles;  ///< by which friends ask
    std::string key;                   ///< with which the phone seals its messages; empty: it does not
    bool code = false;                 ///< print a code for the phone's camera
    bool coloured = false;             ///< in a terminal's colours
    std::vector<std::string> friends;  ///< whom the newcomer sees, and who see the newcomer, exactly
    bool shared = false;               ///< the phone is a child's, or several people's: it says by whom they are seen
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
    /// What is granted, in words. A value.
    struct GrantWords {
        std::string precision = "exact";
        std::string until = {};    ///< as `WallClock::endingOf`
        std::string arrival = {};  ///< the name of the owner's place on whose reaching it ends
        bool aloud = false;
        bool fences = false;  ///< the viewer may be told when the owner comes and goes
    };
    std::string share(const std::string& owner, const std::string& viewer, const GrantWords& words);
    /// The owner goes on with a grant without an end.
    std::string keepGrant(const std::string& owner, const std::string& viewer);
    /// Without a viewer: all secrets of a person.
    std::string revoke(const std::string& owner, const std::string& viewer);
    /// Of one device, by its number in the list that `devices` writes.
    std::string revokeDevice(const std::string& owner, int number);
    std::string devices(const std::string& name);
    std::string setHidden(const std::string& name, bool hidden);
    /// The picture that friends' phones show; without a file: none any more.
    std::string face(const std::string& name, const std::string& file);
    std::string people();
    /// What a command line says of a place. A value.
    struct PlaceWords {
        std::string name;
        std::string at = {};                 ///< "50.21,-3.12"; empty: where it is
        std::optional<std::string> label{};  ///< "none": not any more; none given: as it is
        std::optional<double> radius{};
        std::optional<bool> said{};
        std::string rename = {};  ///< empty: its name stays
        bool remove = false;
    };
    /// Names a place of a person, changes the one of that name, or removes it.
    std::string setPlace(const std::string& name, const PlaceWords& words);
    std::string places(const std::string& name);
    std::string setZone(const std::string& name, const std::string& zone);
    std::string looks(const std::string& name);
    /// Who is told when a person comes and goes, where, and since when.
    std::string fences(const std::string& name);
    /// Ends one of them, by its number in that list.
    std::string endFence(const std::string& name, int number);
    /// A link that opens a person's own page in a browser, once; in a terminal also as a code for a camera.
    std::string link(const std::string& name, bool isTerminal);
    /// Writes a backup while the service runs.
    std::string backup(const std::string& file);
    /// `replace`: also where there are people.
    std::string restore(const std::string& file, bool replace);
    /// After a restore: the person's readers work again.
    std::string confirm(const std::string& name);
    std::string exportPerson(const std::string& name, const std::string& file);
    std::string forget(const std::string& name);
    /// Durations such as "24h" and "7d"; empty: as it is. Says what holds.
    std::string retention(const std::string& name, const std::string& fixes, const std::string& looks);
    /// By which maps places are called something, the finer ones first; none: as it is, which is said. `none`: by none.
    std::string maps(const std::vector<std::string>& files, bool none);
    std::string check();
    /// Where it serves. A value.
    struct Serving {
        std::string address;             ///< for its own certificate; empty: 127.0.0.1, or none beside a socket
        ListeningSocket::Place place{};  ///< a socket for a proxy; without a path: none
    };
    /// Serves until SIGINT or SIGTERM. Where the service manager made sockets, it serves on these.
    std::string serve(const Serving& where);

  private:
    std::string addWithPhone(const Newcomer& who);
    /// What to type into a phone's app, and where.
    void showPhone(const PhoneSetUp& phone, const Newcomer& who);
    /// A new secret for ktr in that file, and the configuration that uses it.
    std::string makeReader(const std::string& name, const std::string& tokenFile, platform::Dictionary& configuration);
    /// The cards of these people, by which whoever asks knows them.
    std::string contactsOf(const std::vector<std::string>& names);
    /// Opens the store; an empty text when it is open.
    std::string open();
    std::optional<Person> person(const std::string& name, std::string& complaint);
    std::optional<NamedPlace> placeNamed(const Person& owner, const std::string& name, std::string& complaint);
    /// What a grant says, for its owner.
    std::string wordsOf(const Person& owner, const Grant& grant);

    const std::string folder_;
    const std::int64_t now_;
    std::ostream& out_;
    std::unique_ptr<Store> store_;
};

}  // namespace ktr::server
