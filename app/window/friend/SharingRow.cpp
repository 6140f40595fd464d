#include "app/window/friend/SharingRow.h"

#include <utility>

namespace ktr::app {

SharingRow::SharingRow(host::Host& host, Wish wish) : ListRow(Kind::Switch), host_(host), wish_(std::move(wish)) {
    setPressed([this] { say(!isSeen_.value_or(false)); });
    setTexts();
}

const char* SharingRow::secondKey() const {
    using Failure = ask::ServiceReply::Failure;
    switch (failure_) {
        case Failure::None:
            break;
        case Failure::NotSignedIn:
            return "STATUS_SIGN_IN";
        case Failure::Refused:
            return "SHARING_REFUSED";
        case Failure::Unreachable:
            return "SHARING_FAILED";
    }
    return !isSeen_ ? "SHARING_UNKNOWN" : *isSeen_ ? "SHARING_ON" : "SHARING_OFF";
}

void SharingRow::refreshed() {
    setTexts();
    ListRow::refreshed();
}

void SharingRow::setTexts() {
    setWords(QString::fromStdString(host_.text("SHARING_SWITCH")));
    setSecond(QString::fromStdString(host_.text(secondKey())));
    setChecked(isSeen_.value_or(false));
    // What is not known cannot be turned round; and no second wish overtakes the first.
    setHeld(!wish_ || isAsking_ || !isSeen_);
}

void SharingRow::say(std::optional<bool> wish) {
    if (!wish_ || isAsking_) {
        return;
    }
    isAsking_ = true;
    setTexts();
    wish_(wish, [self = std::weak_ptr(self_)](const Sharing& sharing) {
        if (const auto row = self.lock()) {
            (*row)->hear(sharing);
        }
    });
}

void SharingRow::hear(const Sharing& sharing) {
    isAsking_ = false;
    failure_ = sharing.failure;
    isSeen_ = sharing.isSeen ? sharing.isSeen : isSeen_;
    setTexts();
    if (heard_) {
        heard_();
    }
}

}  // namespace ktr::app
