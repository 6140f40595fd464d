#include "linux/maps/ConfiguredMaps.h"
#include "tests/contract/MapPictureSourceContract.h"

namespace ktr::test {

INSTANTIATE_TEST_SUITE_P(ConfiguredMaps, MapPictureSourceContract,
                         ::testing::Values(MapSourceCase{
                             "ConfiguredMaps",
                             [](const auto& mainLoop) {
                                 const linux_::Configuration configuration;
                                 auto maps = linux_::ConfiguredMaps::make(configuration, KTR_RESOURCES, mainLoop);
                                 return MapSourceUnderTest{maps, [weak = std::weak_ptr(maps), configuration] {
                                                               if (const auto source = weak.lock()) {
                                                                   source->setGrounds(linux_::ConfiguredMaps::grounds(
                                                                       configuration, KTR_RESOURCES));
                                                               }
                                                           }};
                             }}),
                         [](const auto& tested) { return tested.param.name; });

}  // namespace ktr::test
