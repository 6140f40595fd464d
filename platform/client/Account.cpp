#include "platform/client/DeviceOwnerAccount.h"
#include "platform/client/FriendLocationRestrictions.h"

namespace ktr::platform {

DeviceOwnerAccount::~DeviceOwnerAccount() = default;
AccountStore::~AccountStore() = default;
FriendLocationRestrictions::~FriendLocationRestrictions() = default;

}  // namespace ktr::platform
