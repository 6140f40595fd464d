#include "server/admin/ServiceManager.h"

#include <systemd/sd-daemon.h>

namespace ktr::server {

std::vector<int> ServiceManager::takeSockets() {
    std::vector<int> sockets;
    const int count = ::sd_listen_fds(1);
    for (int i = 0; i < count; ++i) {
        sockets.push_back(SD_LISTEN_FDS_START + i);
    }
    return sockets;
}

void ServiceManager::tellReady() {
    ::sd_notify(0, "READY=1");
}

void ServiceManager::tellStopping() {
    ::sd_notify(0, "STOPPING=1");
}

void ServiceManager::tellAlive() {
    ::sd_notify(0, "WATCHDOG=1");
}

}  // namespace ktr::server
