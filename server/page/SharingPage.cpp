#include "server/page/SharingPage.h"

#include <algorithm>

#include "server/page/PageBuilder.h"
#include "server/page/RuleWords.h"

namespace ktr::server {

namespace {

/// "Three people can see where you are."
std::string titleOf(const PageLanguage& language, std::int64_t count) {
    if (count == 0) {
        return language.text("VISIBLE_TO_NOBODY");
    }
    const std::string words = language.text("NUMBERS");
    // A hyphen alone: digits are usual there.
    std::size_t begin = words == "-" ? std::string::npos : 0;
    for (std::int64_t number = 1; number < count && begin != std::string::npos; ++number) {
        const std::size_t bar = words.find('|', begin);
        begin = bar == std::string::npos ? bar : bar + 1;
    }
    return language.plural("VISIBLE_TO", count,
                           begin == std::string::npos ? "" : words.substr(begin, words.find('|', begin) - begin));
}

void addSwitch(PageBuilder& page, bool hidden) {
    const PageLanguage& language = page.language();
    const std::string label = language.text("VISIBLE");
    page.openForm("/me/visible");
    page.hiddenField("state", hidden ? "on" : "off");
    page.openCard();
    page.html().open("button", {{"class", "row"}}).open("span", {{"class", "grow"}});
    // Who hears it hears the state; who sees it sees the switch.
    page.html().leaf("span", {{"aria-hidden", "true"}}, label);
    page.html().leaf("span", {{"class", "unseen"}}, language.text(hidden ? "SWITCH_OFF" : "SWITCH_ON", {label}));
    page.html().leaf("span", {{"class", "soft"}}, language.text(hidden ? "VISIBLE_OFF" : "VISIBLE_ON"));
    page.html().close().leaf("span", {{"class", hidden ? "switch" : "switch on"}}, "");
    page.html().close().close().close();
}

void addRules(PageBuilder& page, const PageContext& context, const std::vector<PageRule>& rules) {
    const PageLanguage& language = context.language;
    page.section(language.text("WHO_SEES_ME"));
    page.openCard();
    page.html().open("ul");
    for (const PageRule& rule : rules) {
        page.html().open("li").open("a",
                                    {{"class", "row person"}, {"href", "/me/sees/" + std::to_string(rule.viewer)}});
        page.face(rule.name, rule.handle);
        page.html()
            .open("span", {{"class", "grow"}})
            .open("span", {{"class", "name"}})
            .leaf("bdi", {}, shownName(rule.name))
            .close();
        page.html().leaf("span", {{"class", "soft"}}, RuleWords::of(rule, language, context.now)).close();
        page.chevron();
        page.html().close().close();
    }
    page.html().close().open("a", {{"class", "row action"}, {"href", "/me/share"}});
    page.html().leaf("span", {{"class", "grow"}}, language.text("SHARE_WITH"));
    page.plusIcon();
    page.html().close();
    page.close();
}

void addAsks(PageBuilder& page, const PageContext& context, const std::vector<PageAsk>& asks) {
    const PageLanguage& language = context.language;
    const auto button = [&](const std::string& action, const char* key, const std::string& name, bool namesAsker) {
        page.openForm(action);
        if (namesAsker) {
            // The rule is made as every other is: nothing is shared by this button alone.
            page.hiddenField("who", name);
        }
        const std::string words = language.text(key);
        page.html()
            .open("button", {{"class", "end"}, {"aria-label", words + ": " + shownName(name)}})
            .text(words)
            .close();
        page.close();
    };
    page.section(language.text("ASKED_TITLE"));
    page.openCard();
    page.html().open("ul");
    for (const PageAsk& ask : asks) {
        page.html().open("li").open("div", {{"class", "row"}});
        page.face(ask.name, ask.handle.empty() ? ask.name : ask.handle);
        page.html().open("span", {{"class", "grow"}});
        page.html().open("span", {{"class", "name"}}).leaf("bdi", {}, shownName(ask.name)).close();
        page.html().leaf("span", {{"class", "soft"}}, language.moment(ask.time, context.now)).close();
        button("/me/share", "ASKED_SHARE", ask.name, true);
        button("/me/asked/" + std::to_string(ask.asker) + "/no", "ASKED_NOT_NOW", ask.name, false);
        page.html().close().close();
    }
    page.html().close();
    page.close();
}

void addLooks(PageBuilder& page, const PageContext& context, const std::vector<PageLook>& looks, std::size_t most) {
    if (looks.empty()) {
        page.html().open("div", {{"class", "row"}}).text(context.language.text("NOBODY_LOOKED")).close();
        return;
    }
    page.html().open("ul", {{"class", "looks"}});
    for (std::size_t i = 0; i < std::min(most, looks.size()); ++i) {
        const PageLook& look = looks[i];
        page.html().open("li").open("span").leaf("bdi", {}, shownName(look.viewer));
        if (!look.asked) {
            page.html().text(" ").leaf("span", {{"class", "soft"}}, context.language.text("CARRIED"));
        }
        page.html().close().leaf("time", {}, context.language.moment(look.time, context.now)).close();
    }
    page.html().close();
}

}  // namespace

std::string SharingPage::html(const PageContext& context, const Data& data) {
    const PageLanguage& language = context.language;
    std::vector<PageRule> shown;
    std::copy_if(data.rules.begin(), data.rules.end(), std::back_inserter(shown),
                 [&](const PageRule& rule) { return RuleWords::isShown(rule, context.now); });
    const auto open = std::count_if(shown.begin(), shown.end(),
                                    [&](const PageRule& rule) { return !RuleWords::isOver(rule, context.now); });
    PageBuilder page(language, context.token);
    const std::string title = titleOf(language, data.hidden ? 0 : open);
    page.brand(context.name);
    page.heading(title);
    if (!data.told.empty()) {
        page.told(data.told, false);
    }
    addSwitch(page, data.hidden);
    if (!data.asks.empty()) {
        addAsks(page, context, data.asks);
    }
    if (shown.empty()) {
        page.html().open("div", {{"class", "buttons"}});
        page.linkButton(PageBuilder::Button::Main, "/me/share", language.text("SHARE_WITH"));
        page.close();
    } else {
        addRules(page, context, shown);
    }
    page.section(language.text("WHO_LOOKED"));
    page.openCard();
    addLooks(page, context, data.looks, kFewLooks);
    if (data.looks.size() > kFewLooks) {
        page.linkRow("/me/looks", language.plural("ALL_LOOKS", data.looksKept));
    }
    page.close();
    page.section(language.text("MY_DATA"));
    page.openCard();
    page.linkRow("/me/phone", language.text("SET_UP_PHONE"));
    page.linkRow("/me/devices", language.text("MY_DEVICES"));
    page.linkRow("/me/places", language.text("MY_PLACES"));
    page.linkRow("/me/fences", language.text("TOLD_TITLE"));
    page.linkRow("/me/settings", language.text("MY_SETTINGS"));
    page.linkRow("/me/copy", language.text("GET_COPY"));
    page.linkRow("/me/delete", language.text("DELETE_ALL"));
    page.close();
    page.html().open("div", {{"class", "buttons"}});
    page.openForm("/me/out");
    page.button(PageBuilder::Button::Quiet, language.text("SIGN_OUT"));
    page.close();
    page.close();
    return page.finish(title);
}

std::string SharingPage::shareHtml(const PageContext& context, const std::string& typed, const std::string& complaint) {
    const PageLanguage& language = context.language;
    PageBuilder page(language, context.token);
    page.bar(language.text("SHARE_WITH"), "/me");
    if (!complaint.empty()) {
        page.told(complaint, true);
    }
    page.openForm("/me/share");
    page.openCard();
    page.html().open("div", {{"class", "field"}}).leaf("label", {{"for", "who"}}, language.text("SHARE_WHO"));
    page.html().single("input", {{"type", "text"},
                                 {"id", "who"},
                                 {"name", "who"},
                                 {"value", typed},
                                 {"required", ""},
                                 {"maxlength", "254"},
                                 {"autocapitalize", "off"},
                                 {"autocomplete", "off"},
                                 {"dir", "auto"}});
    page.close();
    page.close();
    page.html().open("div", {{"class", "buttons"}});
    page.button(PageBuilder::Button::Main, language.text("GO_ON"));
    page.close();
    page.close();
    return page.finish(language.text("SHARE_WITH"));
}

std::string SharingPage::looksHtml(const PageContext& context, const std::vector<PageLook>& looks, std::int64_t days) {
    const PageLanguage& language = context.language;
    PageBuilder page(language, context.token);
    page.bar(language.text("WHO_LOOKED"), "/me");
    page.section(language.plural("ALL_LOOKS", days));
    page.openCard();
    addLooks(page, context, looks, looks.size());
    page.close();
    return page.finish(language.text("WHO_LOOKED"));
}

}  // namespace ktr::server
