#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <string>
#include <string_view>

namespace ktr::server {

/// Translations as gettext's compiled files (".mo") have them, of one language. They are read without gettext, whose
/// language is that of the whole process: here each who asks has their own. A value; once made any thread.
class MessageCatalogue {
  public:
    /// Null for a file that is missing, damaged, or larger than `kMostBytes`. Waits for the disk.
    static std::shared_ptr<const MessageCatalogue> read(const std::string& file);
    /// The same of its bytes.
    static std::shared_ptr<const MessageCatalogue> parse(std::string bytes);

    static constexpr std::size_t kMostBytes = std::size_t{4} << 20;

    /// Empty when it has none. `context` (msgctxt) may be empty.
    std::string_view find(std::string_view context, std::string_view text) const;
    std::size_t bytes() const { return sizeof *this + bytes_.capacity(); }

  private:
    std::uint32_t number(std::size_t at) const;
    std::string_view string(std::size_t table, std::uint32_t index) const;

    std::string bytes_;
    bool isTurned_ = false;  ///< written by a machine of the other byte order
    std::uint32_t count_ = 0;
    std::size_t originals_ = 0;  ///< where the tables begin
    std::size_t translations_ = 0;
};

}  // namespace ktr::server
