#include "server/page/SettingsPage.h"

#include <algorithm>
#include <vector>

#include "server/page/PageBuilder.h"
#include "server/page/PageTexts.h"

namespace ktr::server {

namespace {

constexpr std::int64_t kHour = 3600;
constexpr std::int64_t kDay = 24 * kHour;

/// Begins a choice with its label; close it twice.
void openSelect(PageBuilder& page, const char* key, const char* name) {
    page.html().open("div", {{"class", "field"}}).leaf("label", {{"for", name}}, page.language().text(key));
    page.html().open("select", {{"id", name}, {"name", name}});
}

void addOption(PageBuilder& page, const std::string& value, const std::string& text, bool isChosen,
               const char* language = nullptr) {
    Html::Attributes option{{"value", value}};
    if (isChosen) {
        option.emplace_back("selected", "");
    }
    if (language != nullptr) {
        option.emplace_back("lang", value);
    }
    page.html().leaf("option", option, text);
}

void addDurations(PageBuilder& page, const char* key, const char* name, std::vector<std::int64_t> offered,
                  std::int64_t chosen) {
    const PageLanguage& language = page.language();
    if (std::find(offered.begin(), offered.end(), chosen) == offered.end()) {
        offered.push_back(chosen);
        std::sort(offered.begin(), offered.end());
    }
    openSelect(page, key, name);
    for (const std::int64_t seconds : offered) {
        const bool inDays = seconds % kDay == 0 && seconds > 2 * kDay;
        addOption(page, std::to_string(seconds),
                  inDays ? language.days(seconds / kDay) : language.hours(seconds / kHour), seconds == chosen);
    }
    page.html().close().close();
}

}  // namespace

std::string SettingsPage::html(const PageContext& context, const Data& data) {
    const PageLanguage& language = context.language;
    PageBuilder page(language, context.token);
    page.bar(language.text("MY_SETTINGS"), "/me");
    if (!data.told.empty()) {
        page.told(data.told, false);
    }
    page.openForm("/me/settings");
    page.openCard();
    openSelect(page, "SETTINGS_LANGUAGE", "language");
    for (const std::string_view tag : PageTexts::languages()) {
        const std::string name(tag);
        addOption(page, name, PageLanguage::ownName(name), name == language.tag(), "own");
    }
    page.html().close().close();
    openSelect(page, "SETTINGS_ZONE", "zone");
    std::vector<std::string> zones = PageLanguage::zones();
    if (std::find(zones.begin(), zones.end(), language.zone()) == zones.end()) {
        zones.insert(zones.begin(), language.zone());
    }
    for (const std::string& zone : zones) {
        addOption(page, zone, zone, zone == language.zone());
    }
    page.html().close().close();
    addDurations(page, "SETTINGS_PLACES_KEPT", "places", {kHour, 6 * kHour, 12 * kHour, kDay, 2 * kDay},
                 data.fixesKept);
    addDurations(page, "SETTINGS_LOOKS_KEPT", "looks", {kDay, 7 * kDay, 14 * kDay, 30 * kDay}, data.looksKept);
    page.close();
    page.html().open("div", {{"class", "buttons"}});
    page.button(PageBuilder::Button::Main, language.text("SAVE"));
    page.close();
    page.close();
    return page.finish(language.text("MY_SETTINGS"));
}

std::string SettingsPage::deleteHtml(const PageContext& context) {
    const PageLanguage& language = context.language;
    PageBuilder page(language, context.token);
    page.bar(language.text("DELETE_ALL"), "/me");
    page.words(language.text("DELETE_ASK"));
    page.html().open("div", {{"class", "buttons"}});
    page.openForm("/me/delete");
    page.button(PageBuilder::Button::Main, language.text("DELETE_NOW"));
    page.close();
    page.linkButton(PageBuilder::Button::Quiet, "/me", language.text("KEEP"));
    page.close();
    return page.finish(language.text("DELETE_ALL"));
}

}  // namespace ktr::server
