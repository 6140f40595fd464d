// `ktr-service serve`.
#include <sys/signalfd.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <chrono>
#include <csignal>

#include "server/admin/Administration.h"
#include "server/admin/ServiceSettings.h"
#include "server/http/CertificateAuthority.h"
#include "server/http/TlsContext.h"
#include "server/service/Service.h"

namespace ktr::server {

namespace {

/// Phones refuse certificates that are good for longer. A new one is made at every start.
constexpr long kCertificateDays = 397;

std::int64_t presentTime() {
    return std::chrono::duration_cast<std::chrono::seconds>(std::chrono::system_clock::now().time_since_epoch())
        .count();
}

/// Blocked in this thread and in those that it makes, as a descriptor.
int endingSignals() {
    sigset_t set;
    sigemptyset(&set);
    sigaddset(&set, SIGINT);
    sigaddset(&set, SIGTERM);
    ::pthread_sigmask(SIG_BLOCK, &set, nullptr);
    std::signal(SIGPIPE, SIG_IGN);
    return ::signalfd(-1, &set, SFD_CLOEXEC);
}

}  // namespace

std::string Administration::serve(const std::string& address) {
    const int signals = endingSignals();
    std::string complaint = open();
    const auto settings = complaint.empty() ? ServiceSettings::read(folder_, complaint) : std::nullopt;
    const auto authority = settings ? CertificateAuthority::read(folder_, complaint) : std::nullopt;
    if (!authority) {
        return complaint.empty() ? folder_ + "/ca.pem: is missing, damaged or about to expire" : complaint;
    }
    const auto pair = authority->issue({"ktr-service", settings->alternativeName(), -1, kCertificateDays});
    Service::Setup setup;
    setup.http.address = address;
    setup.http.port = settings->port;
    setup.http.tls = pair ? TlsContext::make(pair->certificate.get(), pair->key.get()) : nullptr;
    if (!setup.http.tls || signals < 0) {
        return "the certificate cannot be made";
    }
    setup.store = std::move(store_);
    const bool isSix = settings->host.find(':') != std::string::npos;
    setup.hosts = {isSix ? "[" + settings->host + "]" : settings->host};
    setup.now = presentTime;
    Service service(std::move(setup));
    complaint = service.start();
    if (complaint.empty()) {
        out_ << "ready " << settings->origin() << " on " << address << ":" << service.port() << std::endl;
        signalfd_siginfo ending{};
        while (::read(signals, &ending, sizeof ending) < 0 && errno == EINTR) {
        }
        service.stop();
    }
    ::close(signals);
    return complaint;
}

}  // namespace ktr::server
