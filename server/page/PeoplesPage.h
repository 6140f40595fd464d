#pragma once

#include <condition_variable>
#include <cstdint>
#include <deque>
#include <functional>
#include <mutex>
#include <thread>
#include <utility>

#include "server/http/HttpReply.h"
#include "server/page/OwnPages.h"
#include "server/page/PageRequest.h"
#include "server/service/FailureDelays.h"
#include "server/store/Store.h"

namespace ktr::server {

/// The pages for those whose phone has only a tracker: who sees them, how exactly, until when. A browser signs in with
/// a link that works once, and is known by a cookie afterwards; a phone's secret signs nobody in. With such a link a
/// program gets a reader's secret instead. Requests are
/// answered one after the other on a thread of their own, which waits for the disk: the edge's threads do not.
class PeoplesPage {
  public:
    struct Setup {
        Store& store;
        std::function<std::int64_t()> now;  ///< seconds since 1970
        FailureDelays& delays;
        /// Runs something after so many seconds.
        std::function<void(double, std::function<void()>)> later;
    };
    /// So many may wait for their answer.
    static constexpr std::size_t kMostWaiting = 64;

    explicit PeoplesPage(Setup setup);
    /// Answers what waits.
    ~PeoplesPage();
    PeoplesPage(const PeoplesPage&) = delete;
    PeoplesPage& operator=(const PeoplesPage&) = delete;

    /// Any thread.
    void answer(const HttpRequest& request, HttpReply reply);

  private:
    void work();
    HttpResponse answerTo(const PageRequest& request, double& delay);
    HttpResponse signIn(const PageRequest& request, const PageLanguage& language, double& delay);
    /// The same for a program: a reader's secret, once.
    HttpResponse signProgramIn(const PageRequest& request, double& delay);

    Setup setup_;
    OwnPages own_;
    std::mutex mutex_;
    std::condition_variable wake_;
    std::deque<std::pair<PageRequest, HttpReply>> waiting_;
    bool ending_ = false;
    std::thread thread_;
};

}  // namespace ktr::server
