// `ktr-service serve`.
#include <sys/resource.h>
#include <sys/signalfd.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <chrono>
#include <csignal>
#include <optional>
#include <utility>
#include <vector>

#include "server/admin/Administration.h"
#include "server/admin/ServiceManager.h"
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

/// A session's bound of 1,024 descriptors is below the edge's bound of connections.
void allowDescriptors() {
    rlimit limit{};
    if (::getrlimit(RLIMIT_NOFILE, &limit) == 0) {
        limit.rlim_cur = limit.rlim_max;
        ::setrlimit(RLIMIT_NOFILE, &limit);
    }
}

/// A context with a certificate made now. None, with a sentence, when there is no authority to sign it.
std::shared_ptr<SSL_CTX> certified(const std::string& folder, const ServiceSettings& settings, std::string& complaint) {
    const auto authority = CertificateAuthority::read(folder, complaint);
    if (!authority) {
        complaint = complaint.empty() ? folder + "/ca.pem: is missing, damaged or about to expire" : complaint;
        return nullptr;
    }
    const auto pair = authority->issue({"ktr-service", settings.alternativeName(), -1, kCertificateDays});
    auto context = pair ? TlsContext::make(pair->certificate.get(), pair->key.get()) : nullptr;
    complaint = context ? "" : "the certificate cannot be made";
    return context;
}

/// Looks whether the settings name other maps.
class MapsWatch {
  public:
    MapsWatch(std::string folder, std::vector<std::string> maps)
        : folder_(std::move(folder)), maps_(std::move(maps)), state_(ServiceSettings::stateOf(folder_)) {}

    /// Those that hold from now on; none: as before. Settings that cannot be read change nothing.
    std::optional<std::vector<std::string>> changed() {
        std::string complaint;
        if (std::string state = ServiceSettings::stateOf(folder_); state != state_) {
            state_ = std::move(state);
            const auto settings = ServiceSettings::read(folder_, complaint);
            if (settings && settings->maps != maps_) {
                maps_ = settings->maps;
                return maps_;
            }
        }
        return std::nullopt;
    }

  private:
    const std::string folder_;
    std::vector<std::string> maps_;
    std::string state_;
};

}  // namespace

std::string Administration::serve(const Serving& where) {
    const int signals = endingSignals();
    allowDescriptors();
    std::string complaint = open();
    const auto settings = complaint.empty() ? ServiceSettings::read(folder_, complaint) : std::nullopt;
    if (!settings) {
        return complaint;
    }
    Service::Setup setup;
    setup.http.inherited = ServiceManager::takeSockets();
    setup.http.place = where.place;
    const bool hasSocket = !setup.http.inherited.empty() || !where.place.path.empty();
    setup.http.address = where.address.empty() && !hasSocket ? "127.0.0.1" : where.address;
    setup.http.port = settings->port;
    setup.http.tls = setup.http.address.empty() ? nullptr : certified(folder_, *settings, complaint);
    if (!complaint.empty()) {
        return complaint;
    }
    setup.store = std::move(store_);
    const bool isSix = settings->host.find(':') != std::string::npos;
    setup.hosts = {isSix ? "[" + settings->host + "]" : settings->host};
    setup.now = presentTime;
    setup.holdsAnswers = true;
    setup.names = settings->names();
    setup.names.otherMaps = [maps = MapsWatch(folder_, settings->maps)]() mutable { return maps.changed(); };
    setup.alive = ServiceManager::tellAlive;
    const auto log = std::make_shared<ServiceLog>(STDERR_FILENO);
    setup.log = log;
    const std::string place = !setup.http.address.empty() ? setup.http.address
                              : !where.place.path.empty() ? where.place.path
                                                          : "a socket of the service manager";
    Service service(std::move(setup));
    complaint = service.start();
    if (complaint.empty()) {
        const std::string port = service.port() == 0 ? "" : ":" + std::to_string(service.port());
        out_ << "ready " << settings->origin() << " on " << place << port << std::endl;
        ServiceManager::tellReady();
        log->write(ServiceLog::Level::Info, "ready");
        signalfd_siginfo ending{};
        while (::read(signals, &ending, sizeof ending) < 0 && errno == EINTR) {
        }
        ServiceManager::tellStopping();
        log->write(ServiceLog::Level::Info, "stopping");
        service.stop();
    }
    ::close(signals);
    return complaint;
}

}  // namespace ktr::server
