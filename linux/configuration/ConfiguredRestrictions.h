#pragma once

#include <memory>
#include <utility>

#include "linux/configuration/ConfiguredAccountStore.h"
#include "platform/client/FriendLocationRestrictions.h"

namespace ktr::linux_ {

/// The configuration's answers about restrictions. Main thread.
class ConfiguredRestrictions : public platform::FriendLocationRestrictions {
  public:
    explicit ConfiguredRestrictions(std::shared_ptr<const ConfiguredAccountStore> store) : store_(std::move(store)) {}
    bool isFriendLocationRestricted() const override { return store_->configuration().friendLocationRestricted; }
    bool isFriendLocationAllowed() const override { return store_->configuration().friendLocationAllowed; }

  private:
    std::shared_ptr<const ConfiguredAccountStore> store_;
};

}  // namespace ktr::linux_
