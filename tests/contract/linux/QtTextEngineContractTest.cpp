#include "linux/paint/QtTextEngine.h"
#include "tests/contract/TextEngineContract.h"

namespace ktr::test {

INSTANTIATE_TEST_SUITE_P(Linux, TextEngineContract,
                         ::testing::Values(TextEngineCase{"QtTextEngine",
                                                          [] { return std::make_shared<linux_::QtTextEngine>(); }}),
                         nameOfCase);

}  // namespace ktr::test
