#pragma once

#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "platform/assistant/AssistantObject.h"

namespace ktr::platform {

class KTR_API VAEmail : public AssistantObject {
  public:
    ~VAEmail() override;
    std::optional<std::string> emailAddress;
};

class KTR_API VAPhone : public AssistantObject {
  public:
    ~VAPhone() override;
    std::optional<std::string> number;
};

/// A person as the assistant knows them.
class KTR_API VAPerson : public AssistantObject {
  public:
    ~VAPerson() override;
    std::string description() const override;

    std::optional<std::string> fullName;
    std::optional<std::string> firstName;
    std::optional<std::string> lastName;
    /// The assistant's contact identifier.
    std::optional<std::string> identifier;
    std::vector<std::shared_ptr<VAEmail>> emails;
    std::vector<std::shared_ptr<VAPhone>> phones;
};

/// A reference to a person: the person, and the handle by which the service knows them.
class KTR_API VAPersonAttribute : public AssistantObject {
  public:
    ~VAPersonAttribute() override;
    std::shared_ptr<VAPerson> object;
    std::optional<std::string> data;
};

}  // namespace ktr::platform
