// The part of somebody's own pages that is about places with names.
#include <algorithm>

#include "server/page/OwnPages.h"
#include "server/page/PageAnswer.h"
#include "server/page/PlacesPage.h"
#include "server/page/PlainPage.h"

namespace ktr::server {

namespace {

std::optional<NamedPlace> placeOf(const std::vector<NamedPlace>& places, std::int64_t id) {
    const auto found = std::find_if(places.begin(), places.end(), [&](const NamedPlace& one) { return one.id == id; });
    return found == places.end() ? std::nullopt : std::optional(*found);
}

HttpResponse noSuchPlace(const PageLanguage& language) {
    return PageAnswer::html(404, PlainPage::sayingHtml(language, language.text("NO_SUCH_PAGE"), "", true));
}

}  // namespace

HttpResponse OwnPages::placesPage(const Reader& reader, int status, const std::string& typed, const char* complaint) {
    const PageLanguage& language = reader.context.language;
    const PlacesPage::Data data{store_.placesOf(reader.person.id), store_.newestFix(reader.person.id).has_value(),
                                typed, complaint == nullptr ? std::string() : language.text(complaint)};
    return PageAnswer::html(status, PlacesPage::html(reader.context, data));
}

HttpResponse OwnPages::showPlace(const PageRequest& request, const Reader& reader) {
    const auto place = placeOf(store_.placesOf(reader.person.id), request.number(1));
    if (!place) {
        return noSuchPlace(reader.context.language);
    }
    return PageAnswer::html(200, request.parts.size() > 2 ? PlacesPage::removeHtml(reader.context, *place)
                                                          : PlacesPage::changeHtml(reader.context, *place, ""));
}

HttpResponse OwnPages::changePlace(const PageRequest& request, const Reader& reader) {
    const auto places = store_.placesOf(reader.person.id);
    auto place = placeOf(places, request.number(1));
    if (!place) {
        return noSuchPlace(reader.context.language);
    }
    const auto refused = [&](int status, const char* complaint) {
        return PageAnswer::html(
            status, PlacesPage::changeHtml(reader.context, *place, reader.context.language.text(complaint)));
    };
    const std::string name = request.field("name");
    const std::string kind = request.field("kind");
    if (!NamedPlace::isName(name) || !(kind.empty() || NamedPlace::isLabel(kind))) {
        return refused(400, "NOT_UNDERSTOOD");
    }
    place->said = request.field("said") == "yes";
    place->label = kind;
    if (std::any_of(places.begin(), places.end(),
                    [&](const NamedPlace& other) { return other.id != place->id && other.name == name; })) {
        return refused(400, "PLACE_TAKEN");
    }
    place->name = name;
    return store_.changePlace(reader.person.id, *place) ? PageAnswer::seeOther("/me/places") : refused(503, "NOT_KEPT");
}

HttpResponse OwnPages::changePlaces(const PageRequest& request, const Reader& reader) {
    const auto notKept = [&] { return placesPage(reader, 503, request.field("name"), "NOT_KEPT"); };
    if (request.parts.size() > 1) {
        const std::int64_t id = request.number(1);
        if (!store_.removePlace(reader.person.id, id, reader.context.now)) {
            const auto places = store_.placesOf(reader.person.id);
            if (std::any_of(places.begin(), places.end(), [&](const NamedPlace& one) { return one.id == id; })) {
                return notKept();
            }
        }
        return PageAnswer::seeOther("/me/places");
    }
    const auto fix = store_.newestFix(reader.person.id);
    NamedPlace place;
    place.name = request.field("name");
    place.said = request.field("said") == "yes";
    if (!fix || !NamedPlace::isName(place.name)) {
        return placesPage(reader, 400, place.name, fix ? "NOT_UNDERSTOOD" : "PLACE_NO_FIX");
    }
    place.latitude = fix->latitude;
    place.longitude = fix->longitude;
    return store_.setPlace(reader.person.id, place) ? PageAnswer::seeOther("/me/places") : notKept();
}

}  // namespace ktr::server
