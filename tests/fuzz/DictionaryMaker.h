#pragma once

#include <cstddef>
#include <cstdint>

#include "platform/base/Value.h"

namespace ktr::fuzz {

/// Makes an answer of any shape out of bytes: the members that the service knows, now with what belongs there, now with
/// values of any kind and size. What the bytes do not say is absent.
class DictionaryMaker {
  public:
    DictionaryMaker(const std::uint8_t* data, std::size_t size) : at_(data), end_(data + size) {}

    platform::Dictionary answer();

  private:
    std::uint8_t byte();
    /// Of 0 to count - 1.
    std::size_t choice(std::size_t count) { return byte() % count; }
    double real();
    std::string text();
    std::string handle();
    platform::Value anything(int depth = 0);
    /// One time in eight anything, else what `expected` makes.
    template <class Make>
    platform::Value mostly(Make expected);
    platform::Dictionary context();
    platform::Dictionary entry();
    platform::Dictionary location();
    platform::Dictionary address();

    const std::uint8_t* at_;
    const std::uint8_t* end_;
};

}  // namespace ktr::fuzz
