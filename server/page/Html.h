#pragma once

#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace ktr::server {

/// Writes HTML. Whatever is not the name of a tag or of an attribute goes through `escaped`, so that no text can become
/// markup. Elements close in the order in which they were opened. A value; one thread at a time.
class Html {
  public:
    using Attributes = std::vector<std::pair<const char*, std::string>>;

    /// Safe in an element and in a quoted attribute. Malformed UTF-8 becomes U+FFFD, control characters blanks.
    static std::string escaped(std::string_view text);

    Html& open(const char* tag, const Attributes& attributes = {});
    Html& close();
    Html& text(std::string_view text);
    /// An element with a text alone.
    Html& leaf(const char* tag, const Attributes& attributes, std::string_view content);
    /// An element that has no content and no end: <input>, <meta>, <br>.
    Html& single(const char* tag, const Attributes& attributes);
    /// A text of the program's own that is markup already: styles.
    Html& markup(std::string_view trusted);
    /// All of it, with what is open closed. The writer is empty afterwards.
    std::string take();

  private:
    void begin(const char* tag, const Attributes& attributes);

    std::string out_;
    std::vector<const char*> open_;
};

}  // namespace ktr::server
