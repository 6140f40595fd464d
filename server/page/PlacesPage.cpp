#include "server/page/PlacesPage.h"

#include "server/page/PageBuilder.h"

namespace ktr::server {

namespace {

std::string addressOf(const NamedPlace& place) {
    return "/me/places/" + std::to_string(place.id) + "/remove";
}

void addPlaces(PageBuilder& page, const std::vector<NamedPlace>& places) {
    const PageLanguage& language = page.language();
    page.openCard();
    page.html().open("ul");
    for (const NamedPlace& place : places) {
        page.html().open("li").open("div", {{"class", "row"}}).open("span", {{"class", "grow"}});
        page.html().open("span", {{"class", "strong"}}).leaf("bdi", {}, shownName(place.name)).close();
        page.html().leaf("span", {{"class", "soft"}}, language.text(place.said ? "PLACE_SAID" : "PLACE_UNSAID"));
        page.html().close().leaf("a",
                                 {{"class", "end"},
                                  {"href", addressOf(place)},
                                  {"aria-label", language.text("PLACE_REMOVE_ONE", {shownName(place.name)})}},
                                 language.text("PLACE_REMOVE"));
        page.html().close().close();
    }
    page.html().close();
    page.close();
}

void addForm(PageBuilder& page, const std::string& typed) {
    const PageLanguage& language = page.language();
    page.openForm("/me/places");
    page.openCard();
    page.html().open("div", {{"class", "field"}}).leaf("label", {{"for", "name"}}, language.text("PLACE_NAME"));
    page.html()
        .single("input", {{"type", "text"},
                          {"id", "name"},
                          {"name", "name"},
                          {"value", typed},
                          {"required", ""},
                          {"maxlength", "40"},
                          {"autocomplete", "off"},
                          {"dir", "auto"}})
        .close();
    page.html().open("div", {{"class", "row ruled"}});
    page.html().leaf("label", {{"for", "said"}, {"class", "grow"}}, language.text("PLACE_SAID"));
    page.html()
        .single("input",
                {{"type", "checkbox"}, {"class", "switch"}, {"id", "said"}, {"name", "said"}, {"value", "yes"}})
        .close();
    page.close();
    page.note(language.text("PLACE_HERE_HINT"));
    page.html().open("div", {{"class", "buttons"}});
    page.button(PageBuilder::Button::Main, language.text("PLACE_HERE"));
    page.close();
    page.close();
}

}  // namespace

std::string PlacesPage::html(const PageContext& context, const Data& data) {
    const PageLanguage& language = context.language;
    PageBuilder page(language, context.token);
    page.bar(language.text("MY_PLACES"), "/me");
    if (!data.complaint.empty()) {
        page.told(data.complaint, true);
    }
    if (data.places.empty()) {
        page.words(language.text("PLACE_NONE"));
    } else {
        addPlaces(page, data.places);
    }
    page.section(language.text("PLACE_HERE"));
    if (data.knowsWhere) {
        addForm(page, data.typed);
    } else {
        page.words(language.text("PLACE_NO_FIX"));
    }
    return page.finish(language.text("MY_PLACES"));
}

std::string PlacesPage::removeHtml(const PageContext& context, const NamedPlace& place) {
    const PageLanguage& language = context.language;
    const std::string title = language.text("PLACE_REMOVE_ONE", {shownName(place.name)});
    PageBuilder page(language, context.token);
    page.bar(title, "/me/places");
    page.words(language.text("PLACE_REMOVE_ASK"));
    page.html().open("div", {{"class", "buttons"}});
    page.openForm(addressOf(place));
    page.button(PageBuilder::Button::Main, language.text("PLACE_REMOVE"));
    page.close();
    page.linkButton(PageBuilder::Button::Quiet, "/me/places", language.text("KEEP"));
    page.close();
    return page.finish(title);
}

}  // namespace ktr::server
