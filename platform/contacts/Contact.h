#pragma once

#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "platform/base/Object.h"
#include "platform/ui/Image.h"

namespace ktr::platform {

/// A value of a contact with its label ("home", or a built-in one such as "_$!<work>!$_").
struct LabeledText {
    std::string label;
    std::string value;
    bool operator==(const LabeledText&) const = default;
};

/// An entry of the user's contacts. Immutable once it is handed out. A new, empty one stands for nobody.
class KTR_API Contact : public Object {
  public:
    ~Contact() override;
    std::string description() const override;

    /// The contact store's own; empty for a contact that is in no store.
    std::string identifier;
    std::string namePrefix;
    std::string givenName;
    std::string middleName;
    std::string familyName;
    std::string previousFamilyName;
    std::string nameSuffix;
    std::string nickname;
    std::string phoneticGivenName;
    std::string phoneticMiddleName;
    std::string phoneticFamilyName;
    std::string organizationName;
    std::string departmentName;
    std::string jobTitle;
    /// A formatted name that the store holds beside the parts; may be empty.
    std::string storedFullName;
    std::vector<LabeledText> phoneNumbers;
    std::vector<LabeledText> emailAddresses;
    std::optional<Bytes> imageData;
    std::optional<Bytes> thumbnailImageData;
    bool imageDataAvailable = false;

    /// Nobody: neither a name nor a handle nor a picture.
    bool isEmpty() const;
};

}  // namespace ktr::platform
