#pragma once

#include "platform/base/Object.h"

namespace ktr {

/// Base of the records.
class KTRVABaseModel : public platform::Object {
  public:
    /// False when the record cannot be made; the base always can.
    virtual bool init();
};

}  // namespace ktr
