// The part of somebody's own pages that is about places with names.
#include <algorithm>

#include "server/page/OwnPages.h"
#include "server/page/PageAnswer.h"
#include "server/page/PlacesPage.h"
#include "server/page/PlainPage.h"

namespace ktr::server {

HttpResponse OwnPages::placesPage(const Reader& reader, int status, const std::string& typed, const char* complaint) {
    const PageLanguage& language = reader.context.language;
    const PlacesPage::Data data{store_.placesOf(reader.person.id), store_.newestFix(reader.person.id).has_value(),
                                typed, complaint == nullptr ? std::string() : language.text(complaint)};
    return PageAnswer::html(status, PlacesPage::html(reader.context, data));
}

HttpResponse OwnPages::showPlaceRemoval(const PageRequest& request, const Reader& reader) {
    const auto places = store_.placesOf(reader.person.id);
    const auto place =
        std::find_if(places.begin(), places.end(), [&](const NamedPlace& one) { return one.id == request.number(1); });
    const PageLanguage& language = reader.context.language;
    return place == places.end()
               ? PageAnswer::html(404, PlainPage::sayingHtml(language, language.text("NO_SUCH_PAGE"), "", true))
               : PageAnswer::html(200, PlacesPage::removeHtml(reader.context, *place));
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
