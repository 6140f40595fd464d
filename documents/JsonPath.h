#pragma once

#include <cstddef>
#include <string>
#include <variant>
#include <vector>

namespace ktr::documents {

/// Where a value stands in a JSON document: member names and array indices from the root. A value.
class JsonPath {
  public:
    using Step = std::variant<std::string, std::size_t>;

    JsonPath() = default;
    JsonPath member(std::string name) const;
    JsonPath element(std::size_t index) const;

    void push(Step step) { steps_.push_back(std::move(step)); }
    void pop() { steps_.pop_back(); }
    const std::vector<Step>& steps() const { return steps_; }

    /// Such as `$.snippet.locations[2].latitude`; names that are no identifiers stand as `["my name"]`, very long ones
    /// are shortened.
    std::string text() const;

  private:
    std::vector<Step> steps_;
};

}  // namespace ktr::documents
