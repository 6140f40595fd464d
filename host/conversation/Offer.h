#pragma once

#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "host/conversation/Icon.h"
#include "platform/ui/Image.h"

namespace ktr::host {

/// One thing that can be done about an answer, by a press.
struct Offer {
    enum class Kind {
        Button,    ///< an icon, perhaps, and words
        Person,    ///< somebody to choose: a face and a name
        Line,      ///< words alone, in a line of small text
        Question,  ///< one that may be asked: the bubble's form, empty
    };
    Kind kind = Kind::Button;
    std::string words;
    std::function<void()> press = {};
    Icon icon = Icon::None;                      ///< of a button
    std::shared_ptr<platform::Image> face = {};  ///< of a person
};

/// All that stands below an answer's sentence.
struct Offers {
    std::vector<Offer> offers;
    std::string title = {};  ///< above them; empty: none
    std::string note = {};   ///< below them; empty: none
    bool isEmpty() const { return offers.empty() && title.empty() && note.empty(); }
};

}  // namespace ktr::host
