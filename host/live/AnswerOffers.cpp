#include "host/live/AnswerOffers.h"

#include "host/links/FriendLinks.h"
#include "host/links/KnownFriends.h"
#include "platform/contacts/MonogramMaker.h"

namespace ktr::host {

namespace {

using Kind = ask::Action::Kind;

constexpr double kFace = 36.0;
/// Of more than so many who share a name the rest is on the page of all friends.
constexpr std::size_t kChosenAmong = 5;
/// Of so many people that cannot be seen all ways to reach them are offered; of more only to ask them.
constexpr std::size_t kReached = 1;

Offer person(const ask::Choice& choice, const Host& host, const AnswerOffers::Does& does) {
    Offer offer{Offer::Kind::Person, choice.name,
                [choose = does.choose, question = choice.question] { choose(question); }};
    if (const auto& faces = host.platform()->avatarImages) {
        offer.face = faces->avatarForContact(KnownFriends::contactOf(choice.handle), kFace);
    }
    return offer;
}

Offer button(const std::string& words, Icon icon, std::function<void()> press) {
    return {Offer::Kind::Button, words, std::move(press), icon};
}

}  // namespace

void AnswerOffers::addUnseen(const ask::Answer& answer, const Host& host, const Does& does, Offers& offers) {
    for (const ask::Choice& unseen : answer.unseen) {
        const auto contact = KnownFriends::contactOf(unseen.handle);
        const auto ways = FriendLinks::waysTo(contact.get(), unseen.handle);
        if (does.open && answer.unseen.size() <= kReached) {
            if (ways.call) {
                offers.offers.push_back(
                    button(host.text("FRIEND_CALL"), Icon::Call, [open = does.open, url = *ways.call] { open(url); }));
            }
            if (ways.write) {
                offers.offers.push_back(button(host.text("FRIEND_WRITE"), Icon::Write,
                                               [open = does.open, url = *ways.write] { open(url); }));
            }
        }
        if (!unseen.question.empty()) {
            offers.offers.push_back(button(unseen.question, Icon::None,
                                           [choose = does.ask, question = unseen.question] { choose(question); }));
        }
    }
}

Offers AnswerOffers::of(const ask::Answer& answer, const Host& host, const Does& does) {
    Offers offers;
    for (const ask::Choice& choice : answer.choices) {
        if (offers.offers.size() == kChosenAmong) {
            break;
        }
        offers.offers.push_back(person(choice, host, does));
    }
    if (answer.choices.size() > kChosenAmong && does.showFriends) {
        offers.offers.push_back(button(host.text("PAGE_FRIENDS"), Icon::None, does.showFriends));
    }
    addUnseen(answer, host, does, offers);
    const auto& label = answer.action.label;
    const auto add = [&](Icon icon, const std::function<void()>& press) {
        if (press) {
            offers.offers.push_back(button(label, icon, press));
        }
    };
    switch (answer.action.kind) {
        case Kind::TryAgain:
            add(Icon::Again, does.again);
            break;
        case Kind::Unlock:
            // A program that unlocks by itself is no lock: whoever has unlocked is answered.
            add(Icon::Unlock, does.again);
            break;
        case Kind::SignIn:
            add(Icon::None, does.signIn);
            break;
        case Kind::AskOtherwise:
            if (answer.suggestions.empty()) {
                add(Icon::None, does.showFriends);
                break;
            }
            offers.title = label;
            for (const std::string& question : answer.suggestions) {
                offers.offers.push_back(
                    {Offer::Kind::Question, question, [ask = does.ask, question] { ask(question); }});
            }
            break;
        case Kind::None:
        case Kind::ChooseOne:
        case Kind::DidYouMean:
        case Kind::AskToShare:
            break;
    }
    return offers;
}

}  // namespace ktr::host
