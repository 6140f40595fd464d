#include "app/window/Voice.h"

#include "app/window/Announcer.h"
#include "app/window/ConversationWidget.h"
#include "platform/base/Region.h"

namespace ktr::app {

namespace {

using People = std::vector<platform::AccessibilitySubject>;

/// Whom the rows below a view are about.
void collectPeople(const platform::View& view, People& people) {
    for (const auto& child : view.presentedSubviews()) {
        if (child->hidden()) {
            continue;
        }
        if (const auto* about = dynamic_cast<const platform::AccessibilitySubjectView*>(child.get())) {
            if (auto subject = about->accessibilitySubject()) {
                people.push_back(std::move(*subject));
            }
        } else {
            collectPeople(*child, people);
        }
    }
}

People peopleOf(const host::TurnView& turn) {
    People people;
    if (!turn.card()->hidden()) {
        collectPeople(*turn.card(), people);
    }
    return people;
}

}  // namespace

Voice::Voice(host::Host& host, const ConversationWidget& widget)
    : host_(host),
      widget_(widget),
      announcer_(std::make_unique<Announcer>(widget.window())),
      announcements_(
          host.platform()->mainLoop,
          {[&host](const std::string& key) { return host.text(key); },
           [&host](std::size_t number) {
               return host.platform()->decimalNumbers->plainStringFromInteger(static_cast<std::int64_t>(number));
           }},
          [this] { return look(); },
          [this](const std::string& message) { announcer_->say(QString::fromStdString(message)); }) {}

Voice::~Voice() = default;

host::Announcements::State Voice::look() const {
    host::Announcements::State state;
    state.listening = widget_.isActiveWindow();
    using Trouble = host::ServiceWatch::Trouble;
    const auto trouble = host_.live() == nullptr ? Trouble::None : host_.live()->service().notes().trouble;
    state.reachable = trouble == Trouble::None || trouble == Trouble::SignedOut;
    for (const auto& turn : host_.conversation()->turns()) {
        if (!turn->card()->hidden()) {
            state.cards.push_back({turn->card().get(), peopleOf(*turn)});
        }
    }
    return state;
}

void Voice::answerCame(const host::TurnView& turn) {
    announcements_.answerCame(turn.sentence(), peopleOf(turn).size());
}

}  // namespace ktr::app
