#include "linux/paint/QtAvatarImages.h"

#include <algorithm>

#include "linux/paint/ImageDecoder.h"
#include "linux/paint/PersonColors.h"

namespace ktr::linux_ {

namespace {

constexpr std::size_t kMostKept = 256;
/// More than any avatar shows, even on a dense screen.
constexpr int kLongestSide = 512;

std::string contentOf(const platform::Contact& contact) {
    const auto photo = [](const std::optional<platform::Bytes>& data) {
        if (!data) {
            return std::string("-");
        }
        const std::string_view bytes(reinterpret_cast<const char*>(data->data()), data->size());
        return std::to_string(data->size()) + ":" + std::to_string(PersonColors::hash(bytes));
    };
    const Initials initials(contact);
    return PersonColors::handleOf(contact) + '\0' + initials.letters().toStdString() + '\0' + photo(contact.imageData) +
           '\0' + photo(contact.thumbnailImageData) + (contact.imageDataAvailable ? "+" : "-");
}

std::shared_ptr<AvatarImage> make(const platform::Contact& contact, double diameter) {
    for (const auto* data : {&contact.imageData, &contact.thumbnailImageData}) {
        if (data->has_value()) {
            if (const auto picture = ImageDecoder::decode(**data, kLongestSide)) {
                return AvatarImage::photo(diameter, picture->pixels);
            }
        }
    }
    const bool loading = contact.imageDataAvailable && !contact.imageData && !contact.thumbnailImageData;
    return loading ? AvatarImage::blank(diameter)
                   : AvatarImage::letters(diameter, Initials(contact), PersonColors::colorOf(contact));
}

}  // namespace

std::shared_ptr<platform::Image> QtAvatarImages::avatarForContact(const std::shared_ptr<platform::Contact>& contact,
                                                                  double diameter) {
    const bool nobody = !contact || contact->isEmpty();
    const auto known = std::find_if(entries_.begin(), entries_.end(), [&](const Entry& entry) {
        return entry.diameter == diameter && !nobody && entry.contact.lock() == contact;
    });
    if (known != entries_.end()) {
        entries_.splice(entries_.begin(), entries_, known);
        return entries_.front().image;
    }
    const std::string content = nobody ? std::string("nobody") : contentOf(*contact);
    const auto alike = std::find_if(entries_.begin(), entries_.end(), [&](const Entry& entry) {
        return entry.diameter == diameter && entry.content == content;
    });
    if (alike != entries_.end()) {
        entries_.splice(entries_.begin(), entries_, alike);
        entries_.front().contact = contact;
        return entries_.front().image;
    }
    auto image = nobody ? AvatarImage::blank(diameter) : make(*contact, diameter);
    entries_.push_front({contact, diameter, content, image});
    if (entries_.size() > kMostKept) {
        entries_.pop_back();
    }
    return image;
}

}  // namespace ktr::linux_
