#pragma once

#include <QObject>
#include <atomic>
#include <cstdint>
#include <deque>
#include <filesystem>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "app/CrossingWords.h"
#include "linux/net/EventStreamParser.h"
#include "linux/net/HttpsClient.h"

namespace ktr::app {

/// Listens to the service's event stream and hands on each crossing once, in order, over restarts of both: what was
/// handed on is written down before the next one is, and the stream goes on behind it. Main thread.
class CrossingWatch : public QObject {
  public:
    struct Account {
        std::string host;           ///< with ":port" when the port is not 443
        std::string authorization;  ///< the value of the field
        std::vector<std::string> certificateFiles;
        std::optional<std::vector<std::string>> domains;  ///< as in the configuration
    };
    using Next = std::function<void()>;
    struct Setup {
        Account account;
        std::filesystem::path journal;  ///< the number of the last crossing that was handed on
        /// Hands one on, and calls `next` when that is done. What is handed on twice, after the process was ended in
        /// the middle, has the same number.
        std::function<void(const Crossing& crossing, Next next)> handOn;
        std::function<void(const std::string& line)> tell;  ///< for whoever looks on
    };
    /// Seconds between two attempts: from the first to the last of a row that fails.
    static constexpr double kFirstPause = 1.0;
    static constexpr double kLastPause = 60.0;
    /// So many wait to be handed on; the service keeps the rest until they are asked for.
    static constexpr std::size_t kMostWaiting = 1000;

    explicit CrossingWatch(Setup setup);
    ~CrossingWatch() override;
    CrossingWatch(const CrossingWatch&) = delete;
    CrossingWatch& operator=(const CrossingWatch&) = delete;

    void start();

  private:
    void readJournal();
    void listen();
    void listenLater(double pause);
    void ended(const linux_::HttpsAnswer& answer);
    void take(const std::vector<linux_::StreamEvent>& events);
    void handOnNext();
    void handedOn(std::int64_t number);
    void acknowledge();

    const Setup setup_;
    std::int64_t heard_ = 0;
    std::deque<Crossing> waiting_;
    /// Whether the stream under way ends since enough waits here; its thread looks at it.
    std::shared_ptr<std::atomic<bool>> isEnough_;
    bool isBusy_ = false;
    double pause_ = kFirstPause;
    std::string trouble_;  ///< what was said of it last
    linux_::HttpsClient client_;
};

}  // namespace ktr::app
