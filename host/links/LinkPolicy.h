#pragma once

#include <string>
#include <variant>

namespace ktr::host {

/// The one policy for what a link may open. Any thread.
class LinkPolicy {
  public:
    /// Who wants it opened.
    enum class From {
        Conversation,  ///< the plugin, or an answer
        Outside,       ///< another program, or a page in a browser
        FriendPage,    ///< the one page that makes links to places, numbers and addresses itself
    };

    /// Nothing is opened.
    struct Refused {
        bool operator==(const Refused&) const = default;
    };
    /// A friend's page, by the handle as it stands in the link, nothing unescaped; never empty.
    struct Friend {
        std::string handle;
        bool operator==(const Friend&) const = default;
    };
    /// The user's own page.
    struct Self {
        bool operator==(const Self&) const = default;
    };
    /// The list of friends.
    struct Friends {
        bool operator==(const Friends&) const = default;
    };
    /// Another program's matter.
    struct Elsewhere {
        std::string url;
        bool operator==(const Elsewhere&) const = default;
    };
    using Target = std::variant<Refused, Friend, Self, Friends, Elsewhere>;

    /// Longer links are refused, bytes.
    static constexpr std::size_t kLongest = 4096;

    /// Links to friends and https alone; from the friend's page geo, tel and mailto as well. Text that is no UTF-8, or
    /// has a control character, is refused, as are https links without a host or with a user's name in them.
    static Target decide(const std::string& url, From from);
};

}  // namespace ktr::host
