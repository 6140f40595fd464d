#include "tests/unit/server/PrivatePostgres.h"

#include <libpq-fe.h>
#include <pwd.h>
#include <signal.h>
#include <sys/prctl.h>
#include <sys/wait.h>
#include <unistd.h>

#include <chrono>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <sstream>
#include <thread>

namespace ktr::test {

namespace {

/// Where Debian puts what only a server's owner runs.
std::string programFolder() {
    std::error_code ignored;
    std::string found;
    for (const auto& version : std::filesystem::directory_iterator("/usr/lib/postgresql", ignored)) {
        if (std::filesystem::exists(version.path() / "bin/initdb", ignored)) {
            found = (version.path() / "bin/").string();
        }
    }
    return found;
}

}  // namespace

PrivatePostgres* PrivatePostgres::shared() {
    if (std::getenv("KTR_LONG_TESTS") == nullptr) {
        return nullptr;
    }
    // Ended by the program's end.
    static PrivatePostgres server;  // NOLINT(misc-const-correctness)
    return &server;
}

PrivatePostgres::PrivatePostgres() {
    std::string name = (std::filesystem::temp_directory_path() / "ktr-postgres-XXXXXX").string();
    if (programFolder().empty() || ::mkdtemp(name.data()) == nullptr) {
        complaint_ = "there is no PostgreSQL server here: scripts/install-packages store";
        return;
    }
    folder_ = name;
    if (const passwd* nobody = ::geteuid() == 0 ? ::getpwnam("nobody") : nullptr; nobody != nullptr) {
        if (::chown(folder_.c_str(), nobody->pw_uid, nobody->pw_gid) != 0) {
            complaint_ = "the server's folder cannot be given away";
            return;
        }
    }
    int status = 1;
    ::waitpid(run("initdb", "-D data -A trust -U ktr -E UTF8 --locale=C.UTF-8"), &status, 0);
    complaint_ = status == 0 ? "" : "initdb failed: see " + folder_ + "/log";
    if (complaint_.empty()) {
        start();
    }
}

PrivatePostgres::~PrivatePostgres() {
    stop(SIGINT);
    std::error_code ignored;
    std::filesystem::remove_all(folder_, ignored);
}

pid_t PrivatePostgres::run(const std::string& program, const std::string& arguments) const {
    const std::string command = "exec " + programFolder() + program + " " + arguments + " >>log 2>&1 </dev/null";
    const passwd* nobody = ::geteuid() == 0 ? ::getpwnam("nobody") : nullptr;
    const pid_t child = ::fork();
    if (child == 0) {
        if (nobody != nullptr && (::setgid(nobody->pw_gid) != 0 || ::setuid(nobody->pw_uid) != 0)) {
            ::_exit(1);
        }
        // Also when the tests are killed.
        ::prctl(PR_SET_PDEATHSIG, SIGQUIT);
        if (::chdir(folder_.c_str()) == 0) {
            ::execl("/bin/sh", "sh", "-c", command.c_str(), nullptr);
        }
        ::_exit(1);
    }
    return child;
}

void PrivatePostgres::start() {
    server_ = run("postgres", "-D data -k " + folder_ + " -c listen_addresses= -c max_connections=60");
    const std::string address = "postgresql://ktr@/postgres?host=" + folder_;
    for (int i = 0; i < 600; ++i) {
        if (::PQping(address.c_str()) == PQPING_OK) {
            return;
        }
        std::this_thread::sleep_for(std::chrono::milliseconds(50));
    }
    complaint_ = "the server does not answer: see " + folder_ + "/log";
}

void PrivatePostgres::stop(int signal) {
    if (server_ > 0) {
        ::kill(server_, signal);
        ::waitpid(server_, nullptr, 0);
        server_ = -1;
    }
}

void PrivatePostgres::restart() {
    stop(SIGQUIT);
    start();
}

std::string PrivatePostgres::log() const {
    const std::ifstream stream(folder_ + "/log");
    std::ostringstream text;
    text << stream.rdbuf();
    return text.str();
}

std::string PrivatePostgres::newStore() {
    const std::string name = "store" + std::to_string(++stores_);
    const std::string address = "postgresql://ktr@/postgres?host=" + folder_;
    PGconn* const connection = ::PQconnectdb(address.c_str());
    ::PQclear(::PQexec(connection, ("CREATE SCHEMA " + name).c_str()));
    ::PQfinish(connection);
    return address + "&options=-csearch_path%3D" + name;
}

}  // namespace ktr::test
