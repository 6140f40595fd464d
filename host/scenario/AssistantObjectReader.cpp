#include "host/scenario/AssistantObjectReader.h"

#include <utility>

#include "documents/Words.h"
#include "host/conversation/CutText.h"
#include "host/scenario/Scenario.h"

namespace ktr::host {

using namespace platform;

namespace {

/// Parts of a snippet may leave their kind out, since their place tells it; a wrong one is a slip.
void expectKind(documents::FieldReader& fields, const std::string& expected) {
    const auto kind = fields.string("kind");
    if (kind && *kind != expected) {
        fields.complain("kind", "expected " + documents::inQuotes(expected) + ", found " + documents::inQuotes(*kind));
    }
}

void readContext(documents::FieldReader& fields, VASnippet& snippet) {
    if (auto context = fields.string("searchContext")) {
        snippet.searchContext = Url::fromText(*context);
        if (!snippet.searchContext) {
            fields.complain("searchContext", "expected a URL, without white space");
        }
    }
}

/// A text for a row.
std::optional<std::string> readText(documents::FieldReader& fields, const char* name) {
    auto text = fields.string(name);
    return text ? std::optional(cutText(*text, AssistantObjectReader::kLongestText)) : std::nullopt;
}

std::optional<std::string> readHandle(documents::FieldReader& fields, const char* name) {
    auto handle = fields.string(name);
    return handle && handle->size() <= AssistantObjectReader::kLongestText ? std::move(handle) : std::nullopt;
}

/// What every kind of place has.
void readPlace(documents::FieldReader& fields, VALocation& place) {
    place.latitude = fields.number("latitude");
    place.longitude = fields.number("longitude");
    place.accuracy = fields.number("accuracy");
    place.label = readText(fields, "label");
    place.street = readText(fields, "street");
}

}  // namespace

std::shared_ptr<AssistantObject> AssistantObjectReader::readSnippet(documents::FieldReader& fields,
                                                                    std::string& kind) const {
    const auto named = fields.string("kind");
    if (!named) {
        fields.complain("", "expected a member \"kind\" such as \"VAKtrLocationSnippet\"");
        return nullptr;
    }
    kind = *named;
    if (kind == "VAKtrLocationSnippet") {
        return readLocationSnippet(fields);
    }
    if (kind == "VAKtrGeoFenceSnippet") {
        return readGeoFenceSnippet(fields);
    }
    if (kind == "VAKtrVisibilityView") {
        return readVisibilityView(fields);
    }
    fields.leaveOthers();
    return std::make_shared<UnknownAssistantObject>(kind);
}

std::shared_ptr<VAKtrLocationSnippet> AssistantObjectReader::readLocationSnippet(documents::FieldReader& fields) const {
    auto snippet = std::make_shared<VAKtrLocationSnippet>();
    readContext(fields, *snippet);
    snippet->proximity = fields.string("proximity");
    auto locations = std::make_shared<LocationList>();
    fields.objects("locations",
                   [&](documents::FieldReader& location) { locations->push_back(readLocation(location)); });
    snippet->locations = std::move(locations);
    return snippet;
}

std::shared_ptr<VAKtrGeoFenceSnippet> AssistantObjectReader::readGeoFenceSnippet(documents::FieldReader& fields) const {
    auto snippet = std::make_shared<VAKtrGeoFenceSnippet>();
    readContext(fields, *snippet);
    fields.object("cueKtrGeoFence",
                  [&](documents::FieldReader& fence) { snippet->cueKtrGeoFence = readGeoFence(fence); });
    return snippet;
}

std::shared_ptr<VAKtrVisibilityView> AssistantObjectReader::readVisibilityView(documents::FieldReader& fields) const {
    auto snippet = std::make_shared<VAKtrVisibilityView>();
    readContext(fields, *snippet);
    snippet->visible = fields.boolean("visible").value_or(false);
    return snippet;
}

std::shared_ptr<VAKtrGeoFence> AssistantObjectReader::readGeoFence(documents::FieldReader& fields) const {
    expectKind(fields, "VAKtrGeoFence");
    auto fence = std::make_shared<VAKtrGeoFence>();
    fields.object("friend", [&](documents::FieldReader& person) { fence->friend_ = readPersonAttribute(person); });
    fence->geoFenceTrigger = fields.string("geoFenceTrigger");
    fields.object("location", [&](documents::FieldReader& place) {
        expectKind(place, "VALocation");
        fence->location = std::make_shared<VALocation>();
        readPlace(place, *fence->location);
    });
    return fence;
}

std::shared_ptr<VAKtrLocation> AssistantObjectReader::readLocation(documents::FieldReader& fields) const {
    expectKind(fields, "VAKtrLocation");
    auto location = std::make_shared<VAKtrLocation>();
    fields.object("friend", [&](documents::FieldReader& person) { location->friend_ = readPersonAttribute(person); });
    readPlace(fields, *location);
    location->distance = fields.number("distance");
    location->city = readText(fields, "city");
    location->stateCode = readText(fields, "stateCode");
    location->locationDate = readLocationDate(fields);
    return location;
}

std::optional<double> AssistantObjectReader::readLocationDate(documents::FieldReader& fields) const {
    const auto date = fields.number("locationDate");
    const auto age = fields.number("ageSeconds");
    if (date && age) {
        fields.complain("ageSeconds", "expected either locationDate or ageSeconds, found both");
    }
    return age ? std::optional(now_.secondsSinceReferenceDate - *age) : date;
}

std::shared_ptr<VAPersonAttribute> AssistantObjectReader::readPersonAttribute(documents::FieldReader& fields) const {
    expectKind(fields, "VAPersonAttribute");
    auto attribute = std::make_shared<VAPersonAttribute>();
    attribute->data = readHandle(fields, "data");
    fields.object("object", [&](documents::FieldReader& person) { attribute->object = readPerson(person); });
    return attribute;
}

std::shared_ptr<VAPerson> AssistantObjectReader::readPerson(documents::FieldReader& fields) const {
    expectKind(fields, "VAPerson");
    auto person = std::make_shared<VAPerson>();
    person->fullName = readText(fields, "fullName");
    person->firstName = readText(fields, "firstName");
    person->lastName = readText(fields, "lastName");
    person->identifier = fields.string("identifier");
    fields.objects("emails", [&](documents::FieldReader& email) {
        expectKind(email, "VAEmail");
        auto object = std::make_shared<VAEmail>();
        object->emailAddress = readHandle(email, "emailAddress");
        person->emails.push_back(std::move(object));
    });
    fields.objects("phones", [&](documents::FieldReader& phone) {
        expectKind(phone, "VAPhone");
        auto object = std::make_shared<VAPhone>();
        object->number = readHandle(phone, "number");
        person->phones.push_back(std::move(object));
    });
    return person;
}

}  // namespace ktr::host
