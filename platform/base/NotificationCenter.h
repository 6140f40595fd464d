#pragma once

#include <cstdint>
#include <functional>
#include <map>
#include <memory>
#include <mutex>
#include <string>

#include "platform/base/Api.h"
#include "platform/base/Object.h"

namespace ktr::platform {

struct Notification {
    std::string name;
    /// Who posted it; may be none.
    std::shared_ptr<Object> sender;
};

/// Named notifications within the process. Any thread; handlers run on the posting thread, in the order of
/// registration.
class KTR_API NotificationCenter {
  public:
    using Handler = std::function<void(const Notification&)>;

    /// Ends its registration when it is dropped, also after the centre is gone.
    class KTR_API Token {
      public:
        Token() = default;
        Token(Token&& other) noexcept;
        Token& operator=(Token&& other) noexcept;
        ~Token();
        void remove();

      private:
        friend class NotificationCenter;
        struct State;
        Token(std::weak_ptr<State> state, std::uint64_t id) : state_(std::move(state)), id_(id) {}
        std::weak_ptr<State> state_;
        std::uint64_t id_ = 0;
    };

    NotificationCenter();
    ~NotificationCenter();

    /// The handler hears every notification of this name, from any sender. It captures weakly.
    [[nodiscard]] Token addObserver(std::string name, Handler handler);
    /// A handler removed while a notification is being delivered no longer hears it.
    void post(const Notification& notification);
    std::size_t observerCount() const;

  private:
    std::shared_ptr<Token::State> state_;
};

}  // namespace ktr::platform
