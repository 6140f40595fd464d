#pragma once

#include <filesystem>
#include <string>

namespace ktr::linux_ {

/// The app token beside the configuration while another account is written there. At no moment does the token of one
/// account lie beside the other, whose service would be sent it: the earlier token goes before the configuration
/// changes, the new one comes after. What is not brought to its end is taken back when the object goes. Any thread; it
/// waits for the disk.
class TokenChange {
  public:
    /// `token` is the file that is read where the configuration names none.
    explicit TokenChange(std::filesystem::path token);
    ~TokenChange();
    TokenChange(const TokenChange&) = delete;
    TokenChange& operator=(const TokenChange&) = delete;

    /// Each gives a reason, or an empty text when it is done.
    /// Brings a new token to the disk, where nobody looks for one yet.
    std::string prepare(const std::string& token);
    /// The earlier token is found no more.
    std::string takeAway();
    /// The configuration has changed: the new token is found, if one was prepared, and the earlier one is gone for
    /// good.
    std::string finish();

  private:
    std::filesystem::path place_;
    std::filesystem::path fresh_;
    std::filesystem::path earlier_;
    bool isPrepared_ = false;
    bool isAway_ = false;
};

}  // namespace ktr::linux_
