#pragma once

#include <atomic>
#include <filesystem>
#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "linux/net/HttpsClient.h"
#include "linux/net/ServiceCheck.h"

namespace ktr::linux_ {

/// Signs somebody in: asks the service whether it knows them, or what a link stands for, keeps the secret, and writes
/// the configuration, in this order; what is not the case leaves everything as it was, but that a link is spent. Main
/// thread, which never waits.
class SignIn {
  public:
    /// Where the secret is kept.
    enum class Place {
        Keyring,  ///< the Secret Service
        File,     ///< the file "token" beside the configuration, for its owner alone
    };
    struct Wish {
        std::string address;  ///< as it was typed
        std::string person;
        std::string secret;
        Place place = Place::Keyring;
        std::string link = {};  ///< as it was typed; not empty: in place of address, person and secret
    };
    enum class Outcome {
        Done,
        BadAddress,  ///< or a link that is none
        NothingAnswers,
        NotTrusted,
        Unknown,    ///< the service does not know person and secret together, or the link is spent
        NoService,  ///< something else answers there
        Failing,    ///< the service cannot help now
        NoKeyring,  ///< the Secret Service does not keep the secret: locked, not there, or silent
        NotWritten,
    };
    struct Result {
        Outcome outcome = Outcome::NothingAnswers;
        std::string host;    ///< as the address was understood; empty where it was not
        std::string reason;  ///< in words for a log line, without anything private; empty when done
    };
    /// Keeps a secret; false with a reason when it does not. It may wait for the user. Any thread.
    using Store = std::function<bool(const std::string& person, const std::string& host, const std::string& secret,
                                     const std::atomic<bool>& givesUp, std::string& problem)>;

    /// With the user's Secret Service.
    explicit SignIn(const std::filesystem::path& configurationFile);
    SignIn(const std::filesystem::path& configurationFile, Store store);
    /// As `cancel`.
    ~SignIn();
    SignIn(const SignIn&) = delete;
    SignIn& operator=(const SignIn&) = delete;

    /// Calls `done` on the main thread, never inside the call, unless it is cancelled or begun again before.
    void begin(const Wish& wish, std::function<void(const Result&)> done);
    /// Nothing is written any more, unless that has begun.
    void cancel();
    bool isUnderWay() const { return attempt_ != nullptr; }

  private:
    struct Attempt;
    struct Spent;
    void beginWithLink(const Wish& wish);
    static void checked(const std::shared_ptr<Attempt>& attempt, const ServiceCheck::Result& found);
    /// On a thread of its own.
    static Result keep(Attempt& attempt);
    static void end(const std::shared_ptr<Attempt>& attempt, Result result);

    const std::filesystem::path file_;
    const Store store_;
    HttpsClient client_;
    std::shared_ptr<Attempt> attempt_;
    /// What the link that was tried last stands for, once the service has said it and until it is kept: it says it
    /// once, also to somebody who has given up meanwhile.
    std::shared_ptr<Spent> spent_;
};

}  // namespace ktr::linux_
