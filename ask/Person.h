#pragma once

#include <string>
#include <vector>

namespace ktr::ask {

/// Somebody whom the user knows: an entry of the contacts.
struct Person {
    std::string identifier;  ///< the contact's; may be empty
    std::string fullName;    ///< as it is shown; empty: the first other name, else the handle
    std::string firstName;
    std::string lastName;
    std::string nickname;
    std::vector<std::string> emails;
    std::vector<std::string> phones;

    /// By which the service is asked: the first e-mail address, else the first number; empty: by none.
    std::string handle() const { return !emails.empty() ? emails.front() : !phones.empty() ? phones.front() : ""; }
    std::string shownName() const {
        for (const std::string* name : {&fullName, &firstName, &nickname, &lastName}) {
            if (!name->empty()) {
                return *name;
            }
        }
        return handle();
    }
};

}  // namespace ktr::ask
