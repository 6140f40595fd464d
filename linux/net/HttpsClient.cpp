#include "linux/net/HttpsClient.h"

#include <QPointer>
#include <deque>
#include <mutex>
#include <optional>
#include <utility>

#include "linux/net/TlsTrust.h"

namespace ktr::linux_ {

class HttpsClient::Worker {
  public:
    struct Job {
        HttpsRequest request;
        std::vector<std::string> certificateFiles;
        HttpsExchange::Completion completion;
    };

    /// Any thread; everything else on the network thread.
    void add(Job job) {
        const std::lock_guard lock(mutex_);
        waiting_.push_back(std::move(job));
    }

    void startNext() {
        if (auto job = takeNext()) {
            start(std::move(*job));
        }
    }

    void cancelAll() {
        while (auto job = takeNext()) {
            HttpsAnswer answer;
            answer.failure = platform::HttpFailure::Cancelled;
            answer.reason = "cancelled";
            job->completion(std::move(answer));
        }
        for (const auto& exchange : std::exchange(underWay_, {})) {
            if (exchange) {
                exchange->cancel();
            }
        }
    }

  private:
    std::optional<Job> takeNext() {
        const std::lock_guard lock(mutex_);
        if (waiting_.empty()) {
            return std::nullopt;
        }
        std::optional<Job> next = std::move(waiting_.front());
        waiting_.pop_front();
        return next;
    }

    void start(Job job) {
        if (!tls_ || job.certificateFiles != trusted_) {
            trusted_ = std::move(job.certificateFiles);
            tls_ = TlsTrust::configuration(trusted_);
        }
        auto* exchange = new HttpsExchange(*tls_, std::move(job.request), std::move(job.completion));
        std::erase_if(underWay_, [](const auto& earlier) { return earlier.isNull(); });
        underWay_.emplace_back(exchange);
        exchange->start();
    }

    std::mutex mutex_;
    std::deque<Job> waiting_;
    /// Those that are over are none.
    std::vector<QPointer<HttpsExchange>> underWay_;
    std::vector<std::string> trusted_;
    std::optional<QSslConfiguration> tls_;
};

HttpsClient::HttpsClient(std::shared_ptr<NetworkThread> thread)
    : thread_(thread ? std::move(thread) : std::make_shared<NetworkThread>()), worker_(std::make_shared<Worker>()) {}

HttpsClient::~HttpsClient() {
    thread_->run([this] {
        worker_->cancelAll();
        worker_.reset();
    });
}

void HttpsClient::send(HttpsRequest request, std::vector<std::string> certificateFiles,
                       HttpsExchange::Completion completion) {
    worker_->add({std::move(request), std::move(certificateFiles), std::move(completion)});
    thread_->post([weak = std::weak_ptr<Worker>(worker_)] {
        if (const auto worker = weak.lock()) {
            worker->startNext();
        }
    });
}

}  // namespace ktr::linux_
