#pragma once

#include <memory>
#include <string>
#include <vector>

#include "linux/net/HttpsExchange.h"
#include "linux/net/NetworkThread.h"

namespace ktr::linux_ {

/// One user's exchanges on the network thread, with a trust of their own.
class HttpsClient {
  public:
    /// Without a thread it has one of its own.
    explicit HttpsClient(std::shared_ptr<NetworkThread> thread = nullptr);
    /// What is under way ends with `Cancelled`, before this returns.
    ~HttpsClient();
    HttpsClient(const HttpsClient&) = delete;
    HttpsClient& operator=(const HttpsClient&) = delete;

    /// `certificateFiles` are trusted besides the system's. Never calls the completion inside the call, and calls it
    /// once, on the network thread. Any thread.
    void send(HttpsRequest request, std::vector<std::string> certificateFiles, HttpsExchange::Completion completion);

    NetworkThread& thread() { return *thread_; }

  private:
    class Worker;

    std::shared_ptr<NetworkThread> thread_;
    /// Deleted on the thread.
    std::shared_ptr<Worker> worker_;
};

}  // namespace ktr::linux_
