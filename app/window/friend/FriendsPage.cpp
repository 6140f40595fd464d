#include "app/window/friend/FriendsPage.h"

#include <algorithm>
#include <utility>

#include "platform/contacts/MonogramMaker.h"

namespace ktr::app {

using host::KnownFriends;

namespace {

constexpr int kTextStart = 27;
constexpr int kGap = 14;
constexpr int kAboveSection = 20;
constexpr int kBelowSection = 8;
constexpr double kFace = 42.0;

}  // namespace

FriendsPage::FriendsPage(host::Host& host, Open open, std::optional<Sharing> sharing)
    : ColumnPage(Bar::With),
      host_(host),
      open_(std::move(open)),
      sharing_(std::move(sharing)),
      nobody_(new Words(BlockStyle::Body, Words::Tone::Soft)),
      friends_(new ListCard),
      sharersName_(new Words(BlockStyle::Subheadline, Words::Tone::Soft)),
      sharers_(new ListCard),
      self_(new ListCard) {
    column().add(nobody_, {kGap, kTextStart, kTextStart});
    column().add(friends_, {0});
    column().add(sharersName_, {kAboveSection, kTextStart, kTextStart});
    column().add(sharers_, {kBelowSection});
    column().add(self_, {kGap});
    column().setMargins(8, kGap);
}

QString FriendsPage::name() const {
    return QString::fromStdString(host_.text("PAGE_FRIENDS"));
}

void FriendsPage::refreshed() {
    fill();
    ColumnPage::refreshed();
    if (sharing_ && !std::exchange(hasAsked_, true)) {
        sharing_->ask([here = std::weak_ptr(here_)](const Sharers& told) {
            if (const auto page = here.lock()) {
                (*page)->told_ = told;
                (*page)->fill();
            }
        });
    }
}

ListRow* FriendsPage::rowOf(const platform::VAKtrLocation& location) const {
    auto* row = new ListRow(ListRow::Kind::Leads, QString::fromStdString(KnownFriends::nameOf(location)));
    const auto& faces = host_.platform()->avatarImages;
    row->setFace(std::dynamic_pointer_cast<const linux_::QtImage>(
        faces ? faces->avatarForContact(KnownFriends::contactOf(location), kFace) : nullptr));
    return row;
}

void FriendsPage::fill() {
    bar()->setTexts(name(), QString::fromStdString(host_.text("PAGE_BACK")));
    const auto known = KnownFriends(host_).all();
    friends_->setVisible(!known.empty());
    friends_->clear();
    for (const auto& one : known) {
        auto* row = rowOf(*one.location);
        row->setPressed([this, handle = KnownFriends::handleOf(*one.location)] { open_(handle); });
        friends_->add(row);
    }
    fillSharers(known);
    nobody_->setText(QString::fromStdString(host_.text("PAGE_FRIENDS_NONE")));
    nobody_->setVisible(known.empty() && sharers_->rows().empty());
    self_->clear();
    auto* own = new ListRow(ListRow::Kind::Leads, QString::fromStdString(host_.text("PAGE_ME")));
    own->setPressed([this] { open_(""); });
    self_->add(own);
}

void FriendsPage::fillSharers(const std::vector<KnownFriends::Known>& known) {
    sharersName_->setText(QString::fromStdString(host_.text("PAGE_FRIENDS_SHARE")));
    sharers_->clear();
    for (const auto& sharer : told_) {
        const bool isAbove = std::any_of(known.begin(), known.end(), [&](const KnownFriends::Known& one) {
            return KnownFriends::isCalled(*one.location, sharer.handle);
        });
        if (!isAbove) {
            auto* row = rowOf(*KnownFriends::named(sharer.name, sharer.handle).location);
            row->setPressed([this, sharer] { sharing_->open(sharer); });
            sharers_->add(row);
        }
    }
    sharersName_->setVisible(!sharers_->rows().empty());
    sharers_->setVisible(!sharers_->rows().empty());
}

}  // namespace ktr::app
