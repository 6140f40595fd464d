#pragma once

#include <memory>
#include <string>

#include "linux/maps/WorldMap.h"

namespace ktr::linux_ {

/// The names of countries and towns in a language, from ICU's data; what that does not know has its English name. One
/// thread at a time.
class WorldNames {
  public:
    /// BCP 47; empty, or one that is none: English.
    explicit WorldNames(const std::string& language);
    ~WorldNames();
    WorldNames(const WorldNames&) = delete;
    WorldNames& operator=(const WorldNames&) = delete;

    std::string country(const WorldMap::Country& country) const;
    std::string town(const WorldMap::Town& town) const;

  private:
    struct Data;
    std::unique_ptr<Data> data_;
};

}  // namespace ktr::linux_
