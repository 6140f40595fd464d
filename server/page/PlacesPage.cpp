#include "server/page/PlacesPage.h"

#include <utility>

#include "server/page/PageBuilder.h"

namespace ktr::server {

namespace {

/// The sorts of places that clients have words for, with the keys of ours.
constexpr std::pair<const char*, const char*> kKinds[] = {{"", "PLACE_KIND_NONE"},     {"home", "PLACE_KIND_HOME"},
                                                          {"work", "PLACE_KIND_WORK"}, {"school", "PLACE_KIND_SCHOOL"},
                                                          {"gym", "PLACE_KIND_GYM"},   {"other", "PLACE_KIND_OTHER"}};

std::string addressOf(const NamedPlace& place) {
    return "/me/places/" + std::to_string(place.id);
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
                                  {"aria-label", language.text("PLACE_CHANGE_ONE", {shownName(place.name)})}},
                                 language.text("PLACE_CHANGE"));
        page.html().close().close();
    }
    page.html().close();
    page.close();
}

void addFields(PageBuilder& page, const std::string& name, bool isSaid) {
    const PageLanguage& language = page.language();
    page.html().open("div", {{"class", "field"}}).leaf("label", {{"for", "name"}}, language.text("PLACE_NAME"));
    page.html()
        .single("input", {{"type", "text"},
                          {"id", "name"},
                          {"name", "name"},
                          {"value", name},
                          {"required", ""},
                          {"maxlength", "40"},
                          {"autocomplete", "off"},
                          {"dir", "auto"}})
        .close();
    page.html().open("div", {{"class", "row ruled"}});
    page.html().leaf("label", {{"for", "said"}, {"class", "grow"}}, language.text("PLACE_SAID"));
    Html::Attributes box{{"type", "checkbox"}, {"class", "switch"}, {"id", "said"}, {"name", "said"}, {"value", "yes"}};
    if (isSaid) {
        box.emplace_back("checked", "");
    }
    page.html().single("input", box).close();
}

void addForm(PageBuilder& page, const std::string& typed) {
    const PageLanguage& language = page.language();
    page.openForm("/me/places");
    page.openCard();
    addFields(page, typed, false);
    page.close();
    page.note(language.text("PLACE_HERE_HINT"));
    page.html().open("div", {{"class", "buttons"}});
    page.button(PageBuilder::Button::Main, language.text("PLACE_HERE"));
    page.close();
    page.close();
}

void addKinds(PageBuilder& page, const std::string& chosen) {
    const PageLanguage& language = page.language();
    page.html().open("div", {{"class", "field"}}).leaf("label", {{"for", "kind"}}, language.text("PLACE_KIND"));
    page.html().open("select", {{"id", "kind"}, {"name", "kind"}});
    for (const auto& [kind, key] : kKinds) {
        Html::Attributes option{{"value", kind}};
        if (kind == chosen) {
            option.emplace_back("selected", "");
        }
        page.html().leaf("option", option, language.text(key));
    }
    page.html().close().close();
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

std::string PlacesPage::changeHtml(const PageContext& context, const NamedPlace& place, const std::string& complaint) {
    const PageLanguage& language = context.language;
    const std::string title = language.text("PLACE_CHANGE_ONE", {shownName(place.name)});
    PageBuilder page(language, context.token);
    page.bar(title, "/me/places");
    if (!complaint.empty()) {
        page.told(complaint, true);
    }
    page.openForm(addressOf(place));
    page.openCard();
    addFields(page, place.name, place.said);
    addKinds(page, place.label);
    page.close();
    page.html().open("div", {{"class", "buttons"}});
    page.button(PageBuilder::Button::Main, language.text("SAVE"));
    page.linkButton(PageBuilder::Button::Quiet, addressOf(place) + "/remove", language.text("PLACE_REMOVE"));
    page.close();
    page.close();
    return page.finish(title);
}

std::string PlacesPage::removeHtml(const PageContext& context, const NamedPlace& place) {
    const PageLanguage& language = context.language;
    const std::string title = language.text("PLACE_REMOVE_ONE", {shownName(place.name)});
    PageBuilder page(language, context.token);
    page.bar(title, "/me/places");
    page.words(language.text("PLACE_REMOVE_ASK"));
    page.html().open("div", {{"class", "buttons"}});
    page.openForm(addressOf(place) + "/remove");
    page.button(PageBuilder::Button::Main, language.text("PLACE_REMOVE"));
    page.close();
    page.linkButton(PageBuilder::Button::Quiet, "/me/places", language.text("KEEP"));
    page.close();
    return page.finish(title);
}

}  // namespace ktr::server
