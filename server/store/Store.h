#pragma once

#include <atomic>
#include <chrono>
#include <condition_variable>
#include <cstdint>
#include <deque>
#include <functional>
#include <map>
#include <memory>
#include <mutex>
#include <optional>
#include <string>
#include <string_view>
#include <thread>
#include <utility>
#include <vector>

#include "platform/base/Value.h"
#include "server/fences/Fence.h"
#include "server/ingest/Fix.h"
#include "server/rules/FixWalk.h"
#include "server/store/Changes.h"
#include "server/store/Database.h"
#include "server/store/Records.h"
#include "server/store/StoreAddress.h"

namespace ktr::server {

class PostgresHearing;

/// What the service remembers, in one SQLite file ("service.db" in its folder) or on a PostgreSQL server. One thread
/// writes: it takes all that waits into one commit, and says so to those who wait when that commit is on the disk; what
/// one of them cannot do is not done, and refuses none of the others. Reads go beside it. Other processes (the
/// administration; with a server, more of the same service) may use the same store at the same time. Any thread.
class Store {
  public:
    /// Whether what was written is on the disk. Called on the writing thread: it must not wait.
    using Done = std::function<void(bool)>;

    /// None, with a sentence in `complaint`, when it cannot be used, or a newer program has written it. What an older
    /// program has written is brought to today's form. `make`: the store may be new.
    static std::unique_ptr<Store> open(const StoreAddress& address, bool make, std::string& complaint);
    /// Writes what waits.
    ~Store();
    Store(const Store&) = delete;
    Store& operator=(const Store&) = delete;

    /// Returns when all that was to be written so far was, or failed, and those who wait for it have heard.
    void finish();

    /// Tells of changes from now on, of other processes as well: of a server's at once, of a file's within
    /// `kLookAfter`. See Changes.
    [[nodiscard]] std::shared_ptr<void> listen(Changes::Listener listener);
    static constexpr std::chrono::milliseconds kLookAfter{250};

    // Writing, later: `done` follows the commit.

    /// Keeps fixes of a person, each time once; nothing while the person hides. Also notes that the device was heard.
    void keep(std::int64_t device, std::int64_t person, std::vector<Fix> fixes, std::int64_t now, Done done);
    /// Hides somebody from everybody.
    void hide(std::int64_t person, std::int64_t now, Done done);
    /// Notes who saw whom, once an hour; `asked`: not merely carried along with a phone's answer.
    void noteLooks(std::int64_t viewer, std::vector<std::int64_t> owners, bool asked, std::int64_t now, Done done);
    /// Notes that a device asked, in its owner's words, to be shown again. It shows nobody yet.
    void askToShare(std::int64_t device, Done done);
    /// Shows the owner of a device that asked so after the newest hiding, wherever that came from; else does nothing.
    void shareAsAsked(std::int64_t device, std::int64_t now, Done done);
    /// Keeps places that a person named on a phone. One that has this name already is where it is now, and keeps its
    /// label and whether it is said. Beyond `NamedPlace::kMost` nothing is kept that is new.
    void keepPlaces(std::int64_t owner, std::vector<NamedPlace> places, Done done);
    /// Deletes what is too old, of a few people in turn: to be called again and again.
    void deleteOld(std::int64_t now, Done done);

    // Reading.

    /// How many reads have failed. What is put together of several reads that each say "none" is true if this is the
    /// same before and after.
    std::uint64_t readFailures() const { return readFailures_; }
    /// How many fixes have been read to say where people are.
    std::uint64_t fixesRead() const { return fixesRead_; }
    /// Whose secret this is, if it is not revoked. None with `failed` set: the store could not be read.
    std::optional<Device> deviceOf(std::string_view secret, bool& failed);
    /// Who has this handle: e-mail addresses in any case, phone numbers by their digits and "+".
    std::optional<std::int64_t> personOf(std::string_view handle);
    std::optional<Person> person(std::int64_t id);
    std::optional<Person> personNamed(std::string_view name);
    std::vector<Person> people();
    /// What decides what a viewer sees of an owner. None for one whom nobody knows.
    std::optional<Sharing> sharing(std::int64_t viewer, std::int64_t owner);
    /// The same for each of these handles, in their order, with whom it belongs to; none in place of a person for one
    /// that nobody has. It takes as long for a stranger. Of the fixes those alone are read that `Visibility` needs at
    /// `now`. None: the store could not be read.
    std::optional<std::vector<Asked>> asked(std::int64_t viewer, const std::vector<std::string>& handles,
                                            std::int64_t now);
    /// Everybody who has granted something to a viewer; fixes as in `asked`.
    std::vector<Friend> friendsOf(std::int64_t viewer, std::int64_t now);
    /// Who saw somebody, the newest hour first.
    std::vector<Look> looksAt(std::int64_t owner);
    /// A person's newest place, for their own eyes. None: none is kept.
    std::optional<Fix> newestFix(std::int64_t person);
    std::vector<NamedPlace> placesOf(std::int64_t owner);
    /// In the order in which they were made, those whose secret has ended as well.
    std::vector<DeviceFacts> devicesOf(std::int64_t person);
    /// The present, never before the latest that the store has seen: a clock that was set back ends nothing later.
    std::int64_t present(std::int64_t now);

    // Administration: these wait for the disk. False, or none, when it failed or there is no such person.

    bool addPerson(const std::string& name, const std::vector<std::string>& handles, std::int64_t now);
    bool addDevice(std::int64_t person, DeviceKind kind, std::string_view secret, std::string_view key,
                   std::int64_t now, bool shared = false);
    /// A phone, and a link that signs in on it: both or neither. The phone's number; 0 when it failed.
    std::int64_t addPhoneWithLink(std::int64_t person, std::string_view secret, std::string_view link,
                                  std::int64_t now);
    /// Replaces an earlier grant. Who saw as exactly until then goes on seeing; else nothing is seen from before
    /// `grant.from`, nor from before this call.
    bool grant(std::int64_t owner, std::int64_t viewer, const Grant& grant);
    /// Whether there was one.
    bool revokeGrant(std::int64_t owner, std::int64_t viewer);
    /// What a person wishes for those with these handles (text without zeros), in one commit. Whom nobody knows, and
    /// the person themself, it does not concern: nothing tells them from somebody for whom there was nothing to change.
    bool changeRules(std::int64_t owner, const std::vector<std::string>& handles, const RuleWish& wish,
                     std::int64_t now);
    /// The owner says that a grant without an end is still meant.
    Confirmation confirmGrant(std::int64_t owner, std::int64_t viewer, std::int64_t now);
    /// How many secrets of a person ended. Their browsers are signed out, their unused links are void.
    int revokeDevices(std::int64_t person, std::int64_t now);
    /// Whether there was one that was in use. What it asked for ends with it.
    bool revokeDevice(std::int64_t person, std::int64_t device, std::int64_t now);
    bool setHidden(std::int64_t person, bool hidden, std::int64_t now);
    bool setZone(std::int64_t person, const std::string& zone);
    /// Names a place, or changes the one of that name; its id is not used.
    bool setPlace(std::int64_t owner, const NamedPlace& place);
    /// The one with this id. False also when there is none, or another one has its new name.
    bool changePlace(std::int64_t owner, const NamedPlace& place);
    /// Whether there was one. Grants that were to end there end now.
    bool removePlace(std::int64_t owner, std::int64_t place, std::int64_t now);
    std::vector<std::pair<std::string, Grant>> grantsOf(std::int64_t owner);
    /// When one of a person's devices was last heard; none: never.
    std::optional<std::int64_t> lastHeard(std::int64_t person);
    /// How long is kept what; what is too old by it goes at once.
    bool setRetention(std::int64_t person, const Retention& retention, std::int64_t now);
    std::optional<Retention> retention(std::int64_t person);
    /// Deletes a person and all that refers to them. What stays is a hash by which no backup brings them back.
    bool forget(std::int64_t person, std::int64_t now);
    /// All that is kept of a person, by table, others by their names; without secrets. None when it cannot be read.
    std::optional<platform::Dictionary> everythingOf(std::int64_t person);
    /// Writes a backup (see StoreCopy) while others go on; empty when done, else a sentence.
    std::string backup(const std::string& file);
    /// Replaces everything by a backup; empty when done, else a sentence, and nothing was changed. Everybody is hidden
    /// afterwards, and readers do nothing until their person confirms. `folder`: where a copy of the backup can be.
    std::string restore(const std::string& file, const std::string& folder, std::int64_t now);
    /// After a restore, on the word of the person: how many readers work again.
    int confirm(std::int64_t person);
    /// Whether the store is whole: empty, or what is wrong with it.
    std::string check();

    // Browsers: a link signs in once, within 15 minutes; a browser stays signed in for 30 days. Secrets are kept as
    // hashes.

    static constexpr std::int64_t kSignInLasts = std::int64_t{15} * 60;      ///< seconds
    static constexpr std::int64_t kBrowserLasts = std::int64_t{30} * 86400;  ///< seconds
    bool addSignIn(std::int64_t person, std::string_view link, std::int64_t now);
    /// Spends the link, and signs a browser in that holds this secret from then on.
    SignIn signIn(std::string_view link, std::string_view session, std::int64_t now);
    /// Spends the link, and makes a reader with this secret, of the person whose name it gives.
    SignIn signProgramIn(std::string_view link, std::string_view secret, std::int64_t now, std::string& person);
    /// None with `failed` set: the store could not be read.
    std::optional<Browser> browserOf(std::string_view session, std::int64_t now, bool& failed);
    std::vector<Browser> browsersOf(std::int64_t person, std::int64_t now);
    /// False when that could not be written; a browser that is gone is gone.
    bool endBrowser(std::int64_t person, std::int64_t browser);

    // Faces, and the cards that bring them to phones.

    /// What `Face` has cleaned; not while the person hides.
    void keepFace(std::int64_t person, std::string picture, Done done);
    /// The same for the administration, hidden or not; an empty picture takes it away. It waits for the disk.
    bool setFace(std::int64_t person, const std::string& picture);
    std::optional<std::string> face(std::int64_t person);
    /// By owner: the cards of all who share with a viewer, as this device has them.
    std::map<std::int64_t, CardState> cards(std::int64_t device, std::int64_t viewer);
    /// What this phone was last told of who somebody is.
    SentCard sentCard(std::int64_t device, std::int64_t owner);
    void noteCards(std::int64_t device, std::map<std::int64_t, SentCard> sent, Done done);

    // Fences: somebody is told when somebody comes or goes. They end with the grant that they rest on, and with every
    // hiding; what has not been told by then goes in the same commit.

    static constexpr int kMostFences = 10;  ///< of one pair
    /// What became of a wish; the fence when it was set, or there was the same one already. On the writing thread.
    using FenceDone = std::function<void(FenceOutcome, const Fence&)>;
    void setFence(const FenceWish& wish, std::int64_t now, FenceDone done);
    /// Whether there was one with this id, which this person set or which is about this person.
    void endFence(std::int64_t person, std::int64_t id, std::function<void(FenceOutcome)> done);
    /// Waits for the disk.
    FenceOutcome endFence(std::int64_t person, std::int64_t id);
    /// Those that somebody set; the oldest first. None: the store could not be read.
    std::optional<std::vector<FenceFacts>> fencesBy(std::int64_t watcher);
    /// Those that are about somebody.
    std::optional<std::vector<FenceFacts>> fencesAbout(std::int64_t subject);
    /// What a device is to be told that has heard of everything up to `after`; at most `most`. None: the store could
    /// not be read.
    std::optional<std::vector<FenceEvent>> eventsFor(std::int64_t device, std::int64_t after, std::int64_t now,
                                                     int most);
    /// Whether its secret is good: not revoked, nor waiting for its person's word. None: the store could not be read.
    std::optional<bool> isInUse(std::int64_t device);
    /// A device has heard of everything up to this number.
    void acknowledgeEvents(std::int64_t device, std::int64_t number, Done done);
    /// Whether a phone's app shows who came and went.
    void noteHoldsEvents(std::int64_t device, bool holds);
    /// A phone is told of everything up to this number in the answer to a post; of what it was told in answers to
    /// others it has heard.
    void noteEvents(std::int64_t device, std::int64_t number, std::int64_t post);
    /// What nobody heard of in time is deleted and counted here: events that were dropped, in this process.
    std::uint64_t droppedEvents() const { return droppedEvents_; }

    // Wishes for a newer fix than there is: a phone that can be asked reports with its next post.

    static constexpr std::int64_t kWishLasts = std::int64_t{20} * 60;  ///< seconds; a phone at rest is heard within it
    static constexpr int kMostWishes = 50;                             ///< handles of one viewer that wait at a time
    /// For each handle since when a newer fix was asked for, seconds since 1970; 0: there are too many. None: the store
    /// could not be written. On the writing thread.
    using WishDone = std::function<void(std::optional<std::vector<std::int64_t>>)>;
    /// Notes that somebody wants a newer fix of whoever has these handles. One that stands is not made again. It is the
    /// same for everybody, strangers, hidden people and nobody as well: whether a phone was told cannot be told.
    void wishForFix(std::int64_t viewer, const std::vector<std::string>& handles, std::int64_t now, WishDone done);
    /// Whether a phone of this person is to be told to report: once for each wish of somebody who sees them exactly, no
    /// more often than `kWishLasts` for each of these, and not when there is a fix from after the wish. `newest`: of
    /// the fixes of its post, 0 without one.
    void takeWishes(std::int64_t person, std::int64_t newest, std::int64_t now, std::function<void(bool)> done);

    // Asking somebody to share: once a day a person, and what is done and answered does not depend on who is there.

    static constexpr std::int64_t kAskAgainAfter = 86400;   ///< seconds
    static constexpr std::int64_t kAsksKept = 30L * 86400;  ///< seconds
    static constexpr std::int64_t kMostAsks = 100;          ///< of one person on one day
    /// Waits for the disk.
    AskOutcome askToSee(std::int64_t asker, const std::vector<std::string>& handles, std::int64_t now);
    /// Who asks somebody to share and has no answer; whom they let see them already is not among them. The newest
    /// first. None: the store could not be read.
    std::optional<std::vector<AskedBy>> askersOf(std::int64_t person, std::int64_t now);
    /// The answer is no, for now: the asker hears nothing of it. Waits for the disk.
    bool endAsk(std::int64_t person, std::int64_t asker);

    static std::string normalisedHandle(std::string_view handle);

  private:
    /// The connection that reads, for as long as this lives.
    class Reading {
      public:
        explicit Reading(Store& store)
            : lock_(store.readMutex_), database_(*store.reading_), failures_(store.readFailures_) {
            database_.refresh();
        }
        ~Reading() { failures_ += database_.failed() ? 1 : 0; }
        Reading(const Reading&) = delete;
        Reading& operator=(const Reading&) = delete;
        Database* operator->() const { return &database_; }
        Database& operator*() const { return database_; }

      private:
        const std::lock_guard<std::mutex> lock_;
        Database& database_;
        std::atomic<std::uint64_t>& failures_;
    };
    enum class Outcome {
        Kept,
        Refused,  ///< a statement failed
        Broken,   ///< nothing can be written now
    };
    struct Work {
        std::function<void(Database&)> write;
        Done done;
    };

    Store(const StoreAddress& address, std::unique_ptr<Database> reading, std::unique_ptr<Database> writing);
    /// `work` runs on the writing thread, and once more, alone, when what was written together with it failed.
    void write(std::function<void(Database&)> work, Done done);
    /// Waits for the commit.
    bool writeNow(const std::function<void(Database&)>& work);
    void writeAll();
    /// On the writing thread, in a transaction: what will have changed with its commit.
    void changes(std::int64_t person) { changed_.people.insert(person); }
    void changesEverything() { changed_.everything = true; }
    /// Where the person is; other processes hear of it a little later, and wait for nobody.
    void moves(std::int64_t person) { moved_.people.insert(person); }
    void announceMoves();
    void lookAfterOthers();
    /// What others wrote, or all of it.
    void hear(const Change& change);
    /// Waits until something is to be written, or it is time to look after others. False: it is over.
    bool waitForWork(std::deque<Work>& batch);
    Outcome commit(std::deque<Work>::const_iterator begin, std::deque<Work>::const_iterator end);
    /// Of eleven columns: hidden, shown_since, retention, the clock's latest, and a grant's seven.
    Sharing sharingOf(Database::Run& row, int firstColumn);
    /// Of seven columns: exactness, since, until, arrival, aloud, confirmed, fences.
    static Grant grantOf(const Database::Run& row, int firstColumn);
    static std::optional<Grant> readGrant(Database& database, std::int64_t owner, std::int64_t viewer);
    void grantIn(Database& database, std::int64_t owner, std::int64_t viewer, const Grant& grant);
    void revokeByHandleIn(Database& database, std::int64_t owner, const std::string& handle);
    static void askPlaces(std::deque<Database::Run>& runs, Database& database, std::int64_t owner);
    static std::vector<NamedPlace> placesIn(Database::Run& row);
    static std::vector<NamedPlace> readPlaces(Database& database, std::int64_t owner);
    /// Hides somebody, and takes back what their devices asked.
    void hideIn(Database& database, std::int64_t person);
    void showIn(Database& database, std::int64_t person, std::int64_t now);
    /// The first second of which nothing has been heard yet, from the present on.
    std::int64_t afterAllHeard(Database& database, std::int64_t person, std::int64_t now);
    /// Ends grants whose owner has arrived.
    void endOnArrival(Database& database, std::int64_t owner, const std::vector<Fix>& fixes, std::int64_t now);
    /// Sees who crossed a fence with these fixes, which have just been kept.
    void watchFences(Database& database, std::int64_t subject, const std::vector<Fix>& fixes, std::int64_t now);
    /// Puts what happened into the outbox of each device of the watcher's that can be told.
    void tellOf(Database& database, const Fence& fence, const FenceCrossing& crossing);
    void dropLateEvents(Database& database, std::int64_t now);
    static void dropOldWishes(Database& database, std::int64_t now);
    /// Ends those of one pair; without a watcher, of all who watch. With what they have not told.
    void endFencesIn(Database& database, std::int64_t subject, std::optional<std::int64_t> watcher);
    std::optional<std::vector<FenceFacts>> fences(std::int64_t person, const char* sql);
    FenceOutcome setFenceIn(Database& database, const FenceWish& wish, std::int64_t now, Fence& fence);
    /// What else decides what is seen by a grant: fixes, and places where they may be said.
    static void deleteOldOf(Database& database, std::int64_t person, const Retention& retention, std::int64_t now);
    static void readAll(Database& database, std::int64_t owner, Sharing& sharing);
    /// Somebody of whom it is to be read what is needed of their fixes.
    struct Sight {
        std::int64_t owner;
        std::int64_t heardLate;  ///< see FixWalk
        Sharing* sharing;
    };
    void readSights(Database& database, const std::vector<Sight>& sights, std::int64_t now);
    LastRest knownRest(const Sight& sight);
    void keepRest(const Sight& sight, const LastRest& rest);
    void forgetRests();
    struct NewDevice {
        std::int64_t person;
        DeviceKind kind;
        std::string_view secret;
        std::string_view key;
        bool shared;
    };
    static void addDeviceIn(Database& database, std::int64_t device, const NewDevice& made, std::int64_t now);
    /// Whose link it was; 0 for one that is spent, or never was.
    static std::int64_t spendLinkIn(Database& database, std::string_view link, std::int64_t latest);
    void addSignInIn(Database& database, std::int64_t person, std::string_view link, std::int64_t now);
    static void endBrowsersIn(Database& database, std::int64_t person);

    std::atomic<std::uint64_t> readFailures_ = 0;
    std::atomic<std::uint64_t> droppedEvents_ = 0;
    std::atomic<std::uint64_t> fixesRead_ = 0;
    std::mutex readMutex_;
    std::unique_ptr<Database> reading_;
    std::unique_ptr<Database> writing_;
    std::mutex mutex_;
    std::condition_variable wake_;
    std::deque<Work> waiting_;
    bool ending_ = false;
    std::int64_t latest_ = 0;  ///< under `mutex_`
    // On the writing thread.
    std::int64_t lastSwept_ = 0;
    Change changed_;
    Change moved_;
    Change toAnnounce_;  ///< to other processes: where people are
    std::chrono::steady_clock::time_point lastAnnounced_;

    const StoreAddress address_;
    const std::string self_;  ///< who this is to other processes
    Changes changes_;
    // Where people rested last, as coarse viewers see it: what `FixWalk` finds out is not read again.
    std::mutex restMutex_;
    std::map<std::pair<std::int64_t, Precision>, LastRest> rests_;
    std::mutex hearingMutex_;
    std::unique_ptr<PostgresHearing> hearing_;  ///< from the first that listens on, where others announce
    std::thread thread_;
};

}  // namespace ktr::server
