#include <libsecret/secret.h>

#include <algorithm>
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

/// Cancels a call that takes too long.
class Deadline {
  public:
    Deadline(GCancellable* cancellable, double seconds)
        : thread_([this, cancellable, seconds] {
              std::unique_lock<std::mutex> lock(mutex_);
              if (!wake_.wait_for(lock, std::chrono::duration<double>(seconds), [this] { return done_; })) {
                  g_cancellable_cancel(cancellable);
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
                                      std::string& error) const override {
        GCancellable* cancellable = g_cancellable_new();
        GError* failure = nullptr;
        gchar* found = nullptr;
        try {
            const Deadline deadline(cancellable, seconds);
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
};

}  // namespace

}  // namespace ktr::linux_

extern "C" __attribute__((visibility("default"))) ktr::linux_::SecretModule* ktrMakeSecretModule() {
    return new (std::nothrow) ktr::linux_::LibSecretModule;
}
