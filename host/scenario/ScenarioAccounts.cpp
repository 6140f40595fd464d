#include "host/scenario/ScenarioAccounts.h"

#include <utility>

namespace ktr::host {

class ScenarioAccounts::Account : public platform::DeviceOwnerAccount {
  public:
    explicit Account(std::string userName) : userName_(std::move(userName)) {}
    // Whoever has an account has an identifier; this one is never sent.
    std::optional<std::string> personIdentifier() const override { return "scenario"; }
    std::optional<std::string> userName() const override { return userName_; }
    std::optional<std::string> tokenOfType(int /*type*/) const override { return std::nullopt; }
    std::optional<std::string> hostNameOfType(int /*type*/) const override { return std::nullopt; }

  private:
    std::string userName_;
};

ScenarioAccounts::ScenarioAccounts(std::string userName) : account_(std::make_shared<Account>(std::move(userName))) {}

}  // namespace ktr::host
