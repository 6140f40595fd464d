#pragma once

#include <functional>
#include <optional>
#include <string>

#include "documents/JsonPath.h"
#include "platform/base/Value.h"

namespace ktr::documents {

/// The first complaint about a document. Reading goes on after it with nothing in the place of what was wrong, so that
/// readers need no error paths of their own; whoever started the reading looks here at the end.
struct Complaint {
    JsonPath path;
    std::string message;
};
using Complaints = std::optional<Complaint>;

/// Reads the members of one JSON object by name and type. An absent member and a null one both read as none; one of
/// another type is a complaint. Members that nobody asks for are ignored.
class FieldReader {
  public:
    /// `dictionary` outlives the reader.
    FieldReader(const platform::Dictionary& dictionary, JsonPath path, Complaints& complaints)
        : dictionary_(dictionary), path_(std::move(path)), complaints_(complaints) {}

    std::optional<std::string> string(const std::string& name);
    std::optional<double> number(const std::string& name);
    std::optional<bool> boolean(const std::string& name);
    /// Runs `read` on the member's fields; false when there is no such member.
    bool object(const std::string& name, const std::function<void(FieldReader&)>& read);
    /// Runs `read` on the fields of each element of a list of objects; false when there is no such member.
    bool objects(const std::string& name, const std::function<void(FieldReader&)>& read);
    /// A string, or a list of strings.
    std::vector<std::string> stringOrStrings(const std::string& name);
    /// The member as it stands, or null.
    const platform::Value* member(const std::string& name) const;

    /// Complains about a member, or with an empty name about the object itself.
    void complain(const std::string& name, std::string message);
    void complainAt(const JsonPath& path, std::string message);
    const platform::Dictionary& dictionary() const { return dictionary_; }
    const JsonPath& path() const { return path_; }

  private:
    void complainAboutType(const JsonPath& path, const std::string& expected, const platform::Value& found);

    const platform::Dictionary& dictionary_;
    JsonPath path_;
    Complaints& complaints_;
};

/// "a number", "a string", ... for messages.
std::string nameOfKind(const platform::Value& value);

}  // namespace ktr::documents
