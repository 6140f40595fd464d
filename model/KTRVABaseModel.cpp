#include "model/KTRVABaseModel.h"

#include "platform/base/Assert.h"

namespace ktr {

bool KTRVABaseModel::init() {
    KTR_ASSERT_MAIN_THREAD();
    return true;
}

}  // namespace ktr
