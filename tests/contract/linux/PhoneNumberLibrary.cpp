#include "linux/contacts/PhonenumberLibrary.h"
#include "tests/contract/PhoneNumberLibraryContract.h"

namespace ktr::test {

INSTANTIATE_TEST_SUITE_P(PhonenumberLibrary, PhoneNumberLibraryContract,
                         ::testing::Values(PhoneNumberLibraryCase{
                             "PhonenumberLibrary", [] { return std::make_shared<linux_::PhonenumberLibrary>(); }}),
                         [](const auto& tested) { return tested.param.name; });

}  // namespace ktr::test
