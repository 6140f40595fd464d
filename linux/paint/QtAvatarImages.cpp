#include "linux/paint/QtAvatarImages.h"

#include <algorithm>
#include <utility>

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
    if (auto alike = kept(content, diameter)) {
        entries_.front().contact = contact;
        return alike;
    }
    auto image = nobody ? AvatarImage::blank(diameter) : make(*contact, diameter);
    keep({contact, diameter, content, image});
    return image;
}

std::shared_ptr<AvatarImage> QtAvatarImages::photoOf(const platform::Contact& contact, double diameter) {
    if (!contact.imageData && !contact.thumbnailImageData) {
        return nullptr;
    }
    const std::string content = contentOf(contact);
    auto image = kept(content, diameter);
    if (!image) {
        image = make(contact, diameter);
        keep({{}, diameter, content, image});
    }
    return image->isPhoto() ? image : nullptr;
}

std::shared_ptr<AvatarImage> QtAvatarImages::kept(const std::string& content, double diameter) {
    const auto alike = std::find_if(entries_.begin(), entries_.end(), [&](const Entry& entry) {
        return entry.diameter == diameter && entry.content == content;
    });
    if (alike == entries_.end()) {
        return nullptr;
    }
    entries_.splice(entries_.begin(), entries_, alike);
    return entries_.front().image;
}

void QtAvatarImages::keep(Entry entry) {
    entries_.push_front(std::move(entry));
    if (entries_.size() > kMostKept) {
        entries_.pop_back();
    }
}

}  // namespace ktr::linux_
