#include "server/page/RulePage.h"

#include <cstdio>

#include "server/page/PageBuilder.h"
#include "server/page/RuleWords.h"

namespace ktr::server {

namespace {

/// The reader as the viewer gets them: a row of a friend, without a distance, which would tell where the viewer is.
void addSeen(PageBuilder& page, const PageContext& context, const RulePage::Data& data) {
    const PageLanguage& language = context.language;
    const std::string viewer = shownName(data.rule.name);
    if (!data.seen) {
        return page.note(language.text("SEES_NOTHING", {viewer}));
    }
    page.openCard();
    page.html().open("div", {{"class", "row large"}});
    page.face(context.name, context.handle);
    page.html().open("span", {{"class", "grow"}});
    const Seen& seen = *data.seen;
    if (!seen.place.empty()) {
        page.html().open("span", {{"class", "soft"}}).leaf("bdi", {}, shownName(seen.place)).close();
    } else {
        page.html().leaf(
            "bdi", {{"class", "soft"}},
            language.coordinates(seen.latitude, seen.longitude, data.rule.grant.precision == Precision::Exact));
    }
    page.html().open("span", {{"class", "name"}}).leaf("bdi", {}, shownName(context.name)).close();
    page.html().leaf("span", {{"class", "soft"}}, language.age(context.now - seen.time));
    if (seen.accuracy && seen.place.empty()) {
        page.html().leaf("span", {{"class", "soft"}},
                         language.text("A_PLACE_WITHIN", {language.metres(*seen.accuracy)}));
    }
    page.html().close().close();
    page.close();
    page.note(language.text("SEES_THIS", {viewer}));
}

void addChoices(PageBuilder& page, const char* legend) {
    page.html().open("fieldset").leaf("legend", {}, page.language().text(legend));
    page.openCard();
}

void addExactness(PageBuilder& page, Precision chosen) {
    addChoices(page, "HOW_EXACTLY");
    for (const Precision precision : {Precision::Exact, Precision::Kilometre, Precision::Town, Precision::Places}) {
        page.openChoice("exactness", wordOf(precision), RuleWords::of(precision, page.language()), precision == chosen);
        page.close();
    }
    page.html().close().close();
}

void addPlaces(PageBuilder& page, const std::vector<NamedPlace>& places, std::int64_t chosen) {
    page.html().open("select", {{"name", "place"}, {"aria-label", page.language().text("UNTIL_ARRIVAL")}});
    for (const NamedPlace& place : places) {
        Html::Attributes option{{"value", std::to_string(place.id)}};
        if (place.id == chosen) {
            option.emplace_back("selected", "");
        }
        page.html().leaf("option", option, shownName(place.name));
    }
    page.html().close();
}

void addEnd(PageBuilder& page, const PageContext& context, const RulePage::Data& data) {
    const PageLanguage& language = context.language;
    Grant grant = data.rule.grant;
    if (RuleWords::isOver(data.rule, context.now) && !data.isNew) {
        // It is offered as if it began now.
        grant.until.reset();
        grant.arrival = 0;
    }
    const bool midnight = RuleWords::endsAtMidnight(grant, language, context.now);
    const bool hasTime = grant.until && !midnight;
    addChoices(page, "UNTIL");
    page.openChoice("until", "changed", language.text("UNTIL_CHANGED"), !grant.until && grant.arrival == 0);
    page.close();
    page.openChoice("until", "midnight", language.text("UNTIL_MIDNIGHT"), midnight);
    page.close();
    if (!data.places.empty()) {
        page.openChoice("until", "arrival", language.text("UNTIL_ARRIVAL"), grant.arrival != 0);
        addPlaces(page, data.places, grant.arrival);
        page.close();
    }
    page.openChoice("until", "time", language.text("UNTIL_TIME"), hasTime);
    page.html().single("input", {{"type", "time"},
                                 {"name", "time"},
                                 {"aria-label", language.text("UNTIL_TIME")},
                                 {"value", hasTime ? language.fieldTime(*grant.until) : "22:00"}});
    page.close();
    page.html().close().close();
}

/// A switch of its own, with a hint below its label.
void addSwitch(PageBuilder& page, const std::string& name, bool isOn, const std::string& label,
               const std::string& hint) {
    const std::string hintId = name + "-hint";
    Html::Attributes box{{"type", "checkbox"}, {"class", "switch"}, {"name", name},
                         {"value", "yes"},     {"id", name},        {"aria-describedby", hintId}};
    if (isOn) {
        box.emplace_back("checked", "");
    }
    page.openCard(" apart");
    page.html().open("div", {{"class", "row"}}).open("span", {{"class", "grow"}});
    page.html().leaf("label", {{"for", name}}, label);
    page.html().leaf("span", {{"class", "soft"}, {"id", hintId}}, hint);
    page.html().close().single("input", box).close();
    page.close();
}

}  // namespace

std::string RulePage::html(const PageContext& context, const Data& data) {
    const PageLanguage& language = context.language;
    const std::string viewer = shownName(data.rule.name);
    const std::string title = language.text("SEES_TITLE", {viewer});
    const std::string address = "/me/sees/" + std::to_string(data.rule.viewer);
    PageBuilder page(language, context.token);
    page.bar(title, "/me");
    if (!data.told.empty()) {
        page.told(data.told, data.isComplaint);
    }
    if (!data.isNew) {
        addSeen(page, context, data);
    }
    if (data.rule.grant.asks(context.now)) {
        page.openForm(address + "/keep");
        page.note(RuleWords::of(data.rule, language, context.now));
        page.html().open("div", {{"class", "buttons"}});
        page.button(PageBuilder::Button::Outlined, language.text("KEEP_SHARING"));
        page.close();
        page.close();
    }
    page.openForm(data.isNew ? "/me/share/with" : address);
    if (data.isNew) {
        page.hiddenField("who", data.typed);
    }
    addExactness(page, data.rule.grant.precision);
    addEnd(page, context, data);
    addSwitch(page, "aloud", data.rule.grant.aloud, language.text("SAID_ALOUD"),
              language.text("SAID_ALOUD_WHERE", {viewer}));
    addSwitch(page, "fences", data.rule.grant.fences, language.text("TOLD_MAY"),
              language.text("TOLD_MAY_HINT", {language.text("EXACTLY")}));
    page.html().open("div", {{"class", "buttons"}});
    page.button(PageBuilder::Button::Main, language.text("SAVE"));
    if (!data.isNew) {
        page.linkButton(PageBuilder::Button::Quiet, address + "/stop", language.text("STOP", {viewer}));
    }
    page.close();
    page.close();
    return page.finish(title);
}

std::string RulePage::stopHtml(const PageContext& context, const PageRule& rule) {
    const PageLanguage& language = context.language;
    const std::string viewer = shownName(rule.name);
    const std::string address = "/me/sees/" + std::to_string(rule.viewer);
    PageBuilder page(language, context.token);
    page.bar(language.text("STOP", {viewer}), address);
    page.words(language.text("STOP_ASK", {viewer}));
    page.html().open("div", {{"class", "buttons"}});
    page.openForm(address + "/stop");
    page.button(PageBuilder::Button::Main, language.text("STOP", {viewer}));
    page.close();
    page.linkButton(PageBuilder::Button::Quiet, address, language.text("KEEP"));
    page.close();
    return page.finish(language.text("STOP", {viewer}));
}

}  // namespace ktr::server
