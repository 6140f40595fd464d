#pragma once

#include <memory>
#include <string>

#include "platform/client/DeviceOwnerAccount.h"

namespace ktr::host {

/// The account that a scenario tells: a user name alone, without a service and without a secret, so that nothing is
/// sent. Any thread.
class ScenarioAccounts : public platform::AccountStore {
  public:
    explicit ScenarioAccounts(std::string userName);
    std::shared_ptr<platform::DeviceOwnerAccount> deviceOwnerAccount() const override { return account_; }

  private:
    class Account;
    std::shared_ptr<platform::DeviceOwnerAccount> account_;
};

}  // namespace ktr::host
