#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "platform/base/Api.h"
#include "platform/base/Object.h"
#include "platform/base/Url.h"
#include "platform/base/Value.h"

namespace ktr::platform {

/// One argument of a format. Texts and objects are private (a log sink redacts them); plain numbers are not.
/// The member "authToken" of a dictionary or of a URL's query is replaced on the way in and can never be shown.
class KTR_API FormatArgument {
  public:
    FormatArgument(std::nullptr_t) : isNone_(true), isPrivate_(true) {}
    FormatArgument(const char* text);
    FormatArgument(std::string text) : text_(std::move(text)), isPrivate_(true) {}
    FormatArgument(std::string_view text) : text_(text), isPrivate_(true) {}
    FormatArgument(const std::optional<std::string>& text);
    FormatArgument(const Url& url);
    FormatArgument(const std::optional<Url>& url);
    FormatArgument(const Value& value);
    FormatArgument(const Dictionary& dictionary);
    FormatArgument(const std::optional<Dictionary>& dictionary);
    FormatArgument(int number) : text_(std::to_string(number)), number_(number) {}
    FormatArgument(long number) : text_(std::to_string(number)), number_(static_cast<double>(number)) {}
    FormatArgument(double number);
    template <class T>
    requires std::is_base_of_v<Object, T> FormatArgument(const std::shared_ptr<T>& object)
        : isNone_(object == nullptr), isPrivate_(true) {
        if (object) {
            text_ = object->description();
        }
    }

    /// The same argument, shown in logs: for class names, states and keys that say nothing of anybody.
    FormatArgument shown() && {
        isPrivate_ = false;
        return std::move(*this);
    }

    /// "(null)" for none.
    std::string text() const { return isNone_ ? "(null)" : text_; }
    double number() const { return number_; }
    bool isPrivate() const { return isPrivate_; }

  private:
    std::string text_;
    double number_ = 0.0;
    bool isNone_ = false;
    bool isPrivate_ = false;
};

using FormatArguments = std::vector<FormatArgument>;

/// Fills a format: %@ (any argument), %i %d %li (whole numbers), %0.0f (a real without fraction, halves to even),
/// %% (a percent sign) and positional %1$@. Missing arguments read "(null)"; an unknown conversion stands as it is.
/// With `redact`, private arguments read "<private>". A plural text (PluralText.h) is filled in the branch of its first
/// argument. Any thread.
KTR_API std::string formatted(std::string_view format, const FormatArguments& arguments, bool redact = false);

}  // namespace ktr::platform
