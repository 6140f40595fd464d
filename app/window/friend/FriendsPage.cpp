#include "app/window/friend/FriendsPage.h"

#include "host/links/KnownFriends.h"
#include "platform/contacts/MonogramMaker.h"

namespace ktr::app {

using host::KnownFriends;

namespace {

constexpr int kTextStart = 27;
constexpr int kGap = 14;
constexpr double kFace = 42.0;

}  // namespace

FriendsPage::FriendsPage(host::Host& host, Open open)
    : ColumnPage(Bar::With),
      host_(host),
      open_(std::move(open)),
      nobody_(new Words(BlockStyle::Body, Words::Tone::Soft)),
      friends_(new ListCard),
      self_(new ListCard) {
    column().add(nobody_, {kGap, kTextStart, kTextStart});
    column().add(friends_, {0});
    column().add(self_, {kGap});
    column().setMargins(8, kGap);
}

QString FriendsPage::name() const {
    return QString::fromStdString(host_.text("PAGE_FRIENDS"));
}

void FriendsPage::refreshed() {
    fill();
    ColumnPage::refreshed();
}

void FriendsPage::fill() {
    bar()->setTexts(name(), QString::fromStdString(host_.text("PAGE_BACK")));
    const auto known = KnownFriends(host_).all();
    nobody_->setText(QString::fromStdString(host_.text("PAGE_FRIENDS_NONE")));
    nobody_->setVisible(known.empty());
    friends_->setVisible(!known.empty());
    friends_->clear();
    const auto& faces = host_.platform()->avatarImages;
    for (const auto& one : known) {
        auto* row = new ListRow(ListRow::Kind::Leads, QString::fromStdString(KnownFriends::nameOf(*one.location)));
        row->setFace(std::dynamic_pointer_cast<const linux_::QtImage>(
            faces ? faces->avatarForContact(KnownFriends::contactOf(*one.location), kFace) : nullptr));
        row->setPressed([this, handle = KnownFriends::handleOf(*one.location)] { open_(handle); });
        friends_->add(row);
    }
    self_->clear();
    auto* own = new ListRow(ListRow::Kind::Leads, QString::fromStdString(host_.text("PAGE_ME")));
    own->setPressed([this] { open_(""); });
    self_->add(own);
}

}  // namespace ktr::app
