#include "host/asking/QuestionDesk.h"

#include <QDateTime>
#include <utility>

#include "host/Resources.h"
#include "host/scenario/ScenarioReader.h"
#include "linux/contacts/MemoryContactStore.h"
#include "linux/locale/IcuDistanceCalculator.h"
#include "platform/assistant/AssistantSettings.h"
#include "platform/base/Clock.h"
#include "platform/base/DeviceInformation.h"
#include "platform/base/Json.h"
#include "platform/base/MainLoop.h"
#include "platform/base/Region.h"
#include "platform/location/Geodesy.h"
#include "platform/location/PlatformLocationManager.h"

namespace ktr::host {

namespace {

/// Whose preferences may override the units, as for the rows.
constexpr const char* kAppGroup = "group.org.ktr";

ask::World worldOf(Host& host) {
    ask::World world;
    // A loop waits for its workers when it ends: what they leave behind is dropped with it.
    platform::MainLoop* const loop = host.platform()->mainLoop.get();
    world.elsewhere = [loop](std::function<void()> work, std::function<void()> then) {
        loop->runInBackground([loop, work = std::move(work), then = std::move(then)] {
            work();
            loop->post(then);
        });
    };
    world.isLocked = [&host] {
        const auto& lock = host.platform()->deviceLock;
        const int state = lock ? lock->lockState() : platform::DeviceLock::kWithoutLock;
        return state == platform::DeviceLock::kLocked || state == platform::DeviceLock::kLocking;
    };
    world.distance = [&host](double metres, const std::string& language) -> std::optional<std::string> {
        const auto& platform = *host.platform();
        const auto calculator = platform.distanceCalculators->makeDistanceCalculator(
            {kAppGroup, language, platform.region->localeIdentifier(), platform.localization});
        const auto* words = dynamic_cast<const linux_::IcuDistanceCalculator*>(calculator.get());
        return words == nullptr ? std::nullopt : words->localizedDistance(metres);
    };
    world.metres = [&host](double latitude, double longitude, double otherLatitude, double otherLongitude) {
        return host.platform()->geodesy->distance({latitude, longitude}, {otherLatitude, otherLongitude});
    };
    return world;
}

std::vector<std::string> valuesOf(const std::vector<platform::LabeledText>& texts) {
    std::vector<std::string> values;
    values.reserve(texts.size());
    for (const platform::LabeledText& text : texts) {
        values.push_back(text.value);
    }
    return values;
}

}  // namespace

QuestionDesk::QuestionDesk(Host& host, Audience audience)
    : host_(host),
      audience_(audience),
      requests_([&host] { return host.platform(); }),
      engine_(std::make_shared<ask::Languages>(resourceFolder() / "questions"),
              audience == Audience::User ? static_cast<ask::ServicePort&>(requests_) : aloud_, worldOf(host)) {}

void QuestionDesk::readPeople() {
    const auto& platform = *host_.platform();
    if (contacts_.lock() == platform.contactStore) {
        return;
    }
    contacts_ = platform.contactStore;
    const auto* store = dynamic_cast<const linux_::MemoryContactStore*>(platform.contactStore.get());
    std::vector<ask::Person> people;
    for (const auto& contact : store == nullptr ? platform::ContactStore::Contacts() : store->contacts()) {
        ask::Person person;
        if (const auto identifier = platform.assistantContacts->assistantIdentifierForContact(*contact)) {
            person.identifier = *identifier;
        }
        person.fullName =
            platform.contactFormatter->stringFromContact(*contact, platform::ContactFormatterStyle::FullName)
                .value_or("");
        person.firstName = contact->givenName;
        person.lastName = contact->familyName;
        person.nickname = contact->nickname;
        person.emails = valuesOf(contact->emailAddresses);
        person.phones = valuesOf(contact->phoneNumbers);
        people.push_back(std::move(person));
    }
    engine_.setPeople(std::move(people));
}

ask::Question QuestionDesk::questionInWords(const std::string& text) const {
    ask::Question question;
    question.text = text;
    question.language = host_.settings().language;
    question.now = host_.platform()->clock->now();
    question.secondsFromUtc = QDateTime::currentDateTime().offsetFromUtc();
    question.mayChange = audience_ == Audience::User;
    return question;
}

ask::Question QuestionDesk::question(const std::string& text, bool isLive) {
    ask::Question question = questionInWords(text);
    question.isLive = isLive;
    if (!positions_ && host_.live() != nullptr && host_.live()->looksForPosition()) {
        positions_ = host_.platform()->locationManagers->makeManager(nullptr);
        positions_->setDesiredAccuracy(platform::kLocationAccuracyNearestTenMeters);
        positions_->startUpdatingLocation();
    }
    if (const auto location = positions_ ? positions_->location() : nullptr) {
        const auto& fix = location->fix();
        question.position = ask::Position{fix.coordinate.latitude, fix.coordinate.longitude, std::nullopt};
        if (fix.horizontalAccuracy > 0.0) {
            question.position->accuracy = fix.horizontalAccuracy;
        }
    }
    return question;
}

void QuestionDesk::ask(const ask::Question& question, const ask::Engine::Completion& completion,
                       const ask::Engine::Meant& understood) {
    if (host_.live() != nullptr && host_.live()->isUnusable()) {
        // Who the contacts are is said there, too: "I don't know Ann" would be no honest answer.
        ask::Answer unreadable;
        unreadable.outcome = ask::Outcome::NotSignedIn;
        unreadable.sentence = host_.text("STATUS_UNREADABLE");
        return completion(std::move(unreadable));
    }
    engine().ask(
        question,
        [alive = std::weak_ptr<bool>(alive_), completion](ask::Answer answer) {
            if (alive.lock()) {
                completion(std::move(answer));
            }
        },
        understood);
}

Scenario QuestionDesk::scenarioOf(const ask::Answer& answer) const {
    platform::Dictionary turn{{"sentence", answer.sentence}};
    if (!answer.snippet.isNull()) {
        turn.set("snippet", answer.snippet);
    }
    auto read = ScenarioReader(host_.platform()->clock->now(), ScenarioReader::Clock::Present)
                    .readText(platform::writeJson(turn), "the answer");
    if (auto* scenario = std::get_if<Scenario>(&read)) {
        return std::move(*scenario);
    }
    Scenario sentence;
    sentence.sentence = LocalizedText(answer.sentence);
    return sentence;
}

}  // namespace ktr::host
