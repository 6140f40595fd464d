#pragma once

#include <string>
#include <string_view>
#include <variant>
#include <vector>

#include "documents/DocumentError.h"
#include "serve/Fault.h"

namespace ktr::serve {

/// The faults of a run, in their order: a request gets the first one that concerns it. docs/service-protocol.md
/// describes the file and the words. Any thread.
class FaultScript {
  public:
    static std::variant<FaultScript, documents::DocumentError> readFile(
        const std::string& file, documents::DocumentWarnings* warnings = nullptr);
    static std::variant<FaultScript, documents::DocumentError> readText(
        std::string_view text, const std::string& file, documents::DocumentWarnings* warnings = nullptr);
    /// One fault in words, such as "status=503,at=2,count=1". A comma in a value is written twice. None, with the
    /// reason in `complaint`, for what is no fault.
    static std::optional<Fault> readWords(const std::string& words, std::string& complaint);

    void add(Fault fault) { faults_.push_back(std::move(fault)); }
    const std::vector<Fault>& faults() const { return faults_; }
    /// A fault that changes nothing when none concerns the request.
    Fault faultFor(int request) const;

  private:
    std::vector<Fault> faults_;
};

}  // namespace ktr::serve
