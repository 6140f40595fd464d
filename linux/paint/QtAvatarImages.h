#pragma once

#include <list>
#include <memory>
#include <string>

#include "linux/paint/AvatarImage.h"
#include "platform/contacts/MonogramMaker.h"

namespace ktr::linux_ {

/// See platform::AvatarImages. A contact whose photo is announced but not there yet shows the blank figure; a photo
/// that cannot be read gives way to the letters. Images are kept, the least recently used ones are dropped. Main
/// thread, while a QGuiApplication exists.
class QtAvatarImages final : public platform::AvatarImages {
  public:
    std::shared_ptr<platform::Image> avatarForContact(const std::shared_ptr<platform::Contact>& contact,
                                                      double diameter) override;
    /// The contact's photo; none where there is none that can be read.
    std::shared_ptr<AvatarImage> photoOf(const platform::Contact& contact, double diameter);

  private:
    struct Entry {
        /// The contact it was made for: the same object needs no comparing.
        std::weak_ptr<platform::Contact> contact;
        double diameter = 0.0;
        /// All that the picture depends on.
        std::string content;
        std::shared_ptr<AvatarImage> image;
    };

    /// The one that was made of this, used now; none.
    std::shared_ptr<AvatarImage> kept(const std::string& content, double diameter);
    void keep(Entry entry);

    /// Most recently used first.
    std::list<Entry> entries_;
};

}  // namespace ktr::linux_
