#pragma once

#include <functional>
#include <memory>
#include <string>
#include <thread>

#include "server/store/Changes.h"

struct pg_conn;

namespace ktr::server {

/// Hears what other processes announce of a store on a PostgreSQL server, on a thread and a connection of its own. What
/// was announced while there was no connection is gone: each time that there is one, and when it is lost, everything
/// may have changed. A lost connection is made again once a second.
class PostgresHearing {
  public:
    /// What each announcement is called.
    static constexpr const char* kChannel = "ktr_changes";
    /// Bytes that an announcement may have: less than what the server takes.
    static constexpr std::size_t kLongestLine = 7000;

    /// `own`: who this process is when it announces something; that is not told. `tell` is called on the thread.
    PostgresHearing(std::string address, std::string own, std::function<void(const Change&)> tell);
    /// Ends it, at once.
    ~PostgresHearing();
    PostgresHearing(const PostgresHearing&) = delete;
    PostgresHearing& operator=(const PostgresHearing&) = delete;

  private:
    struct Finish {
        void operator()(pg_conn* connection) const;
    };
    using Connection = std::unique_ptr<pg_conn, Finish>;

    void run();
    /// None when nobody answers, or it is ending.
    Connection connected() const;
    bool listens(pg_conn* connection) const;
    void hear(pg_conn* connection) const;
    /// Waits for a descriptor, or none (-1), for so many milliseconds (-1: for ever). False: it is ending.
    bool waitFor(int descriptor, short events, int milliseconds) const;

    const std::string address_;
    const std::string own_;
    const std::function<void(const Change&)> tell_;
    int ending_ = -1;  ///< becomes readable
    std::thread thread_;
};

}  // namespace ktr::server
