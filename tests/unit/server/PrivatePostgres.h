#pragma once

#include <sys/types.h>

#include <string>

namespace ktr::test {

/// A PostgreSQL server of one test program: in a temporary folder, on a Unix socket alone, under a user without rights
/// when the tests run as root. It ends with the object, and with the program.
class PrivatePostgres {
  public:
    PrivatePostgres();
    ~PrivatePostgres();
    PrivatePostgres(const PrivatePostgres&) = delete;
    PrivatePostgres& operator=(const PrivatePostgres&) = delete;

    /// The one of this program, started when it is first asked for; none when it has not been asked for: long tests do.
    static PrivatePostgres* shared();
    /// Empty when it runs, else why not.
    const std::string& complaint() const { return complaint_; }
    /// The address of a new, empty store.
    std::string newStore();
    /// What it has written down.
    std::string log() const;
    /// Ends it at once, as a crash would, and starts it again.
    void restart();

  private:
    /// The process, which runs under the server's user.
    pid_t run(const std::string& program, const std::string& arguments) const;
    void start();
    void stop(int signal);

    std::string folder_;
    std::string complaint_;
    pid_t server_ = -1;
    int stores_ = 0;
};

}  // namespace ktr::test
