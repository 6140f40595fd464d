#include "server/store/PostgresHearing.h"

#include <libpq-fe.h>
#include <poll.h>
#include <sys/eventfd.h>
#include <unistd.h>

#include <array>

#include "server/store/PostgresParameters.h"

namespace ktr::server {

namespace {

constexpr int kBetweenAttempts = 1000;  // milliseconds
constexpr int kPatience = 5000;         // milliseconds, for one step of a connection

}  // namespace

void PostgresHearing::Finish::operator()(pg_conn* connection) const {
    ::PQfinish(connection);
}

PostgresHearing::PostgresHearing(std::string address, std::string own, std::function<void(const Change&)> tell)
    : address_(std::move(address)),
      own_(std::move(own)),
      tell_(std::move(tell)),
      ending_(::eventfd(0, EFD_CLOEXEC | EFD_NONBLOCK)) {
    thread_ = std::thread([this] { run(); });
}

PostgresHearing::~PostgresHearing() {
    ::eventfd_write(ending_, 1);
    thread_.join();
    ::close(ending_);
}

bool PostgresHearing::waitFor(int descriptor, short events, int milliseconds) const {
    std::array<pollfd, 2> both{{{ending_, POLLIN, 0}, {descriptor, events, 0}}};
    ::poll(both.data(), both.size(), milliseconds);
    return both[0].revents == 0;
}

PostgresHearing::Connection PostgresHearing::connected() const {
    const PostgresParameters parameters(address_);
    Connection connection(::PQconnectStartParams(parameters.names.data(), parameters.values.data(), 1));
    PostgresPollingStatusType next = PGRES_POLLING_WRITING;
    while (connection && ::PQstatus(connection.get()) != CONNECTION_BAD && next != PGRES_POLLING_FAILED &&
           next != PGRES_POLLING_OK) {
        const auto events = static_cast<short>(next == PGRES_POLLING_READING ? POLLIN : POLLOUT);
        if (!waitFor(::PQsocket(connection.get()), events, kPatience)) {
            return nullptr;
        }
        next = ::PQconnectPoll(connection.get());
    }
    return next == PGRES_POLLING_OK ? std::move(connection) : nullptr;
}

bool PostgresHearing::listens(pg_conn* connection) const {
    ::PQsetNoticeProcessor(
        connection, [](void*, const char*) {}, nullptr);
    bool isGood = ::PQsendQuery(connection, (std::string("LISTEN ") + kChannel).c_str()) == 1;
    while (isGood && ::PQisBusy(connection) != 0) {
        isGood = waitFor(::PQsocket(connection), POLLIN, kPatience) && ::PQconsumeInput(connection) == 1;
    }
    while (isGood) {
        PGresult* const result = ::PQgetResult(connection);
        if (result == nullptr) {
            return true;
        }
        isGood = ::PQresultStatus(result) == PGRES_COMMAND_OK;
        ::PQclear(result);
    }
    return false;
}

void PostgresHearing::hear(pg_conn* connection) const {
    while (waitFor(::PQsocket(connection), POLLIN, -1) && ::PQconsumeInput(connection) == 1) {
        Change change;
        while (PGnotify* const heard = ::PQnotifies(connection)) {
            std::string sender;
            const Change one = Change::ofLine(heard->extra, sender);
            ::PQfreemem(heard);
            if (sender != own_) {
                change.add(one);
            }
        }
        if (!change.isNothing()) {
            tell_(change);
        }
    }
}

void PostgresHearing::run() {
    do {
        const Connection connection = connected();
        if (connection && listens(connection.get())) {
            tell_({true, {}});
            hear(connection.get());
            tell_({true, {}});
        }
    } while (waitFor(-1, 0, kBetweenAttempts));
}

}  // namespace ktr::server
