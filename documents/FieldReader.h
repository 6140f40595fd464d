#pragma once

#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "documents/JsonPath.h"
#include "platform/base/Value.h"

namespace ktr::documents {

/// What is wrong in a document, and where.
struct Complaint {
    JsonPath path;
    std::string message;
};

/// What was found while reading. Reading goes on after a complaint with nothing in the place of what was wrong, so that
/// readers need no error paths of their own; whoever started the reading looks here at the end.
struct Complaints {
    /// Of the unknown members so many are kept, and the others counted.
    static constexpr std::size_t kMostUnknown = 8;

    std::optional<Complaint> first;
    std::vector<Complaint> unknown;  ///< members that no reader knows
    std::size_t moreUnknown = 0;

    explicit operator bool() const { return first.has_value(); }
    const Complaint* operator->() const { return &*first; }
};

/// Reads the members of one JSON object by name and type. An absent member and a null one both read as none; one of
/// another type is a complaint, and so is one out of its range.
class FieldReader {
  public:
    /// `dictionary` and `complaints` outlive the reader.
    FieldReader(const platform::Dictionary& dictionary, JsonPath path, Complaints& complaints)
        : dictionary_(dictionary), path_(std::move(path)), complaints_(complaints) {}

    std::optional<std::string> string(const std::string& name);
    /// A string that is not empty and has no control characters: a name, a path, a host.
    std::optional<std::string> text(const std::string& name);
    std::optional<double> number(const std::string& name);
    /// A number from `least` to `most`; infinity as `most` allows any.
    std::optional<double> number(const std::string& name, double least, double most);
    std::optional<int> whole(const std::string& name, int least, int most);
    std::optional<bool> boolean(const std::string& name);
    /// Runs `read` on the member's fields; false when there is no such member.
    bool object(const std::string& name, const std::function<void(FieldReader&)>& read);
    /// Runs `read` on the fields of each element of a list of objects; false when there is no such member.
    bool objects(const std::string& name, const std::function<void(FieldReader&)>& read);
    /// A list of strings that `text` would take.
    std::vector<std::string> texts(const std::string& name);
    /// A string, or a list of strings.
    std::vector<std::string> stringOrStrings(const std::string& name);
    /// The member as it stands, or null.
    const platform::Value* member(const std::string& name);

    /// Complains about a member, or with an empty name about the object itself.
    void complain(const std::string& name, std::string message);
    void complainAt(const JsonPath& path, std::string message);

    /// Members that this reader does not know are none of its business: no warning is given.
    void leaveOthers() { leavesOthers_ = true; }
    /// The members that no reader has asked for so far, in the document's order. "$schema" is always known.
    std::vector<std::string> unasked() const;
    /// What was asked for so far.
    const std::vector<std::string>& asked() const { return asked_; }
    /// Notes what no reader asked for; called after everything else was. `object` and `objects` do it for what they
    /// read.
    void warnOfOthers();

    const platform::Dictionary& dictionary() const { return dictionary_; }
    const JsonPath& path() const { return path_; }

  private:
    bool isText(const JsonPath& path, const std::string& text);
    void complainAboutType(const JsonPath& path, const std::string& expected, const platform::Value& found);

    const platform::Dictionary& dictionary_;
    JsonPath path_;
    Complaints& complaints_;
    std::vector<std::string> asked_;
    bool leavesOthers_ = false;
};

/// "a number", "a string", ... for messages.
std::string nameOfKind(const platform::Value& value);

}  // namespace ktr::documents
