#pragma once

#include <map>
#include <memory>
#include <mutex>
#include <string>

#include "platform/base/PluralRules.h"

namespace ktr::linux_ {

/// The rules of every language that ICU knows. Any thread.
class IcuPluralRules : public platform::PluralRules {
  public:
    IcuPluralRules();
    ~IcuPluralRules() override;
    IcuPluralRules(const IcuPluralRules&) = delete;
    IcuPluralRules& operator=(const IcuPluralRules&) = delete;

    std::string category(const std::string& number, const std::string& language) const override;

  private:
    struct Rules;

    const Rules& rulesOf(const std::string& language) const;

    /// Rules are dear to make: some 0.2 ms a language.
    mutable std::mutex mutex_;
    mutable std::map<std::string, std::unique_ptr<Rules>> known_;
};

}  // namespace ktr::linux_
