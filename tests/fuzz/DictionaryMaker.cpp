#include "tests/fuzz/DictionaryMaker.h"

#include <array>
#include <cstring>
#include <limits>
#include <string>

namespace ktr::fuzz {

using platform::Dictionary;
using platform::Value;

namespace {

constexpr std::array<std::int64_t, 8> kIntegers = {
    0, 1, 411, 416, -1, 60000, std::numeric_limits<std::int64_t>::min(), std::numeric_limits<std::int64_t>::max()};
constexpr std::array<const char*, 8> kHandles = {
    "ann@example.org", "BOB@example.org", "+442079460018", "020 7946 0018", "", "@", "\xF0\x9F\x98\x80", "nobody"};

}  // namespace

std::uint8_t DictionaryMaker::byte() {
    return at_ < end_ ? *at_++ : std::uint8_t{0};
}

double DictionaryMaker::real() {
    std::array<std::uint8_t, sizeof(double)> bytes{};
    for (auto& one : bytes) {
        one = byte();
    }
    double number = 0.0;
    std::memcpy(&number, bytes.data(), sizeof number);
    // JSON has no others.
    return number - number == 0.0 ? number : 0.0;
}

std::string DictionaryMaker::text() {
    std::string out;
    for (std::size_t left = choice(24); left > 0 && at_ < end_; --left) {
        out.push_back(static_cast<char>(byte()));
    }
    return out;
}

std::string DictionaryMaker::handle() {
    const std::size_t which = choice(kHandles.size() + 1);
    return which < kHandles.size() ? kHandles[which] : text();
}

Value DictionaryMaker::anything(int depth) {
    switch (choice(depth > 3 ? 6 : 8)) {
        case 0:
            return Value();
        case 1:
            return Value(choice(2) == 1);
        case 2:
            return Value(kIntegers[choice(kIntegers.size())]);
        case 3:
            return Value(static_cast<double>(static_cast<std::int8_t>(byte())));
        case 4:
            return Value(real());
        case 5:
            return Value(text());
        case 6: {
            Value::Array elements;
            for (std::size_t left = choice(4); left > 0; --left) {
                elements.push_back(anything(depth + 1));
            }
            return Value(std::move(elements));
        }
        default: {
            Dictionary members;
            for (std::size_t left = choice(4); left > 0; --left) {
                std::string name = text();
                members.set(std::move(name), anything(depth + 1));
            }
            return Value(std::move(members));
        }
    }
}

template <class Make>
Value DictionaryMaker::mostly(Make expected) {
    return choice(8) == 7 ? anything() : Value(expected());
}

Dictionary DictionaryMaker::context() {
    Dictionary made;
    made.set("minCallbackIntervalInMS", mostly([&] { return real(); }));
    made.set("authToken", mostly([&] { return text(); }));
    std::string name = text();
    made.set(std::move(name), anything());
    return made;
}

Dictionary DictionaryMaker::address() {
    Dictionary made;
    made.set("locality", mostly([&] { return text(); }));
    made.set("administrativeArea", mostly([&] { return text(); }));
    if (choice(2) == 1) {
        made.set("stateCode", mostly([&] { return text(); }));
    }
    return made;
}

Dictionary DictionaryMaker::location() {
    Dictionary made;
    made.set("latitude", mostly([&] { return real(); }));
    made.set("longitude", mostly([&] { return real(); }));
    made.set("horizontalAccuracy", mostly([&] { return real(); }));
    made.set("timestamp", mostly([&] { return real(); }));
    made.set("streetAddress", mostly([&] { return text(); }));
    made.set("labels", mostly([&] {
                 return Value::Array{mostly([&] { return Dictionary{{"label", mostly([&] { return text(); })}}; })};
             }));
    made.set("address", mostly([&] { return address(); }));
    return made;
}

Dictionary DictionaryMaker::entry() {
    Dictionary made;
    if (choice(4) == 3) {
        made.set("status", mostly([&] { return kIntegers[choice(kIntegers.size())]; }));
    }
    made.set("match", mostly([&] { return choice(2) == 1; }));
    made.set("distanceInMeters", mostly([&] { return text(); }));
    made.set("location", mostly([&] { return location(); }));
    return made;
}

Dictionary DictionaryMaker::answer() {
    Dictionary made;
    made.set("statusCode", mostly([&] { return kIntegers[choice(kIntegers.size())]; }));
    made.set("serverContext", mostly([&] { return context(); }));
    made.set("locations", mostly([&] {
                 Dictionary entries;
                 for (std::size_t left = choice(5); left > 0; --left) {
                     std::string key = handle();
                     entries.set(std::move(key), mostly([&] { return entry(); }));
                 }
                 return entries;
             }));
    if (choice(2) == 1) {
        made.set("emails", mostly([&] {
                     Value::Array handles;
                     for (std::size_t left = choice(6); left > 0; --left) {
                         handles.push_back(mostly([&] { return handle(); }));
                     }
                     return handles;
                 }));
    }
    if (choice(2) == 1) {
        made.set("myInfo", mostly([&] {
                     Dictionary mine = entry();
                     mine.set("preferredEmail", mostly([&] { return handle(); }));
                     return mine;
                 }));
    }
    return made;
}

}  // namespace ktr::fuzz
