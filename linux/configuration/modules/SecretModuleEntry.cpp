#include <libsecret/secret.h>

#include <algorithm>
#include <atomic>
#include <chrono>
#include <condition_variable>
#include <exception>
#include <mutex>
#include <new>
#include <thread>

#include "linux/configuration/SecretModule.h"

namespace ktr::linux_ {

namespace {

const SecretSchema* schema() {
    static const SecretSchema kSchema = {"org.ktr.AppToken",
                                         SECRET_SCHEMA_DONT_MATCH_NAME,
                                         {{"application", SECRET_SCHEMA_ATTRIBUTE_STRING},
                                          {"person", SECRET_SCHEMA_ATTRIBUTE_STRING},
                                          {"host", SECRET_SCHEMA_ATTRIBUTE_STRING},
                                          {nullptr, SECRET_SCHEMA_ATTRIBUTE_STRING}},
                                         0,
                                         nullptr,
                                         nullptr,
                                         nullptr,
                                         nullptr,
                                         nullptr,
                                         nullptr,
                                         nullptr};
    return &kSchema;
}

/// Cancels a call that takes too long, or that nobody waits for any more.
class Deadline {
  public:
    Deadline(GCancellable* cancellable, double seconds, const std::atomic<bool>& givesUp)
        : thread_([this, cancellable, seconds, &givesUp] {
              constexpr std::chrono::milliseconds kLook(50);
              const auto end = std::chrono::steady_clock::now() + std::chrono::duration<double>(seconds);
              std::unique_lock<std::mutex> lock(mutex_);
              while (!wake_.wait_for(lock, kLook, [this] { return done_; })) {
                  if (givesUp || std::chrono::steady_clock::now() >= end) {
                      g_cancellable_cancel(cancellable);
                      return;
                  }
              }
          }) {}
    ~Deadline() {
        {
            const std::lock_guard<std::mutex> lock(mutex_);
            done_ = true;
        }
        wake_.notify_all();
        thread_.join();
    }

  private:
    std::mutex mutex_;
    std::condition_variable wake_;
    bool done_ = false;
    std::thread thread_;
};

class LibSecretModule : public SecretModule {
  public:
    std::optional<std::string> lookUp(const std::string& person, const std::string& host, double seconds,
                                      const std::atomic<bool>& givesUp, std::string& error) const override {
        GCancellable* cancellable = g_cancellable_new();
        GError* failure = nullptr;
        gchar* found = nullptr;
        try {
            const Deadline deadline(cancellable, seconds, givesUp);
            found = secret_password_lookup_sync(schema(), cancellable, &failure, "application", "ktr", "person",
                                                person.c_str(), "host", host.c_str(), nullptr);
        } catch (const std::exception& problem) {
            error = problem.what();
        }
        g_object_unref(cancellable);
        std::optional<std::string> secret;
        if (failure != nullptr) {
            error = failure->message;
            g_error_free(failure);
        } else if (found != nullptr) {
            secret = found;
        }
        secret_password_free(found);
        return secret;
    }

    bool store(const std::string& person, const std::string& host, const std::string& secret, double seconds,
               const std::atomic<bool>& givesUp, std::string& error) const override {
        GCancellable* cancellable = g_cancellable_new();
        GError* failure = nullptr;
        gboolean isKept = FALSE;
        try {
            const Deadline deadline(cancellable, seconds, givesUp);
            isKept = secret_password_store_sync(schema(), SECRET_COLLECTION_DEFAULT, "ktr", secret.c_str(), cancellable,
                                                &failure, "application", "ktr", "person", person.c_str(), "host",
                                                host.c_str(), nullptr);
        } catch (const std::exception& problem) {
            error = problem.what();
        }
        g_object_unref(cancellable);
        if (failure != nullptr) {
            error = failure->message;
            g_error_free(failure);
        }
        if (isKept == FALSE && error.empty()) {
            error = "the keyring was not unlocked";
        }
        return isKept != FALSE;
    }

    bool forget(const std::string& person, const std::string& host, double seconds, const std::atomic<bool>& givesUp,
                std::string& error) const override {
        GCancellable* cancellable = g_cancellable_new();
        GError* failure = nullptr;
        try {
            const Deadline deadline(cancellable, seconds, givesUp);
            secret_password_clear_sync(schema(), cancellable, &failure, "application", "ktr", "person", person.c_str(),
                                       "host", host.c_str(), nullptr);
        } catch (const std::exception& problem) {
            error = problem.what();
        }
        g_object_unref(cancellable);
        if (failure != nullptr) {
            error = failure->message;
            g_error_free(failure);
        }
        return error.empty();
    }
};

}  // namespace

}  // namespace ktr::linux_

extern "C" __attribute__((visibility("default"))) ktr::linux_::SecretModule* ktrMakeSecretModule() {
    return new (std::nothrow) ktr::linux_::LibSecretModule;
}
