#include "server/page/DevicesPage.h"

#include "server/page/PageBuilder.h"

namespace ktr::server {

namespace {

std::string kindOf(const PageDevice& device, const PageLanguage& language) {
    switch (device.kind) {
        case PageDevice::Kind::Phone:
            return language.text("DEVICE_PHONE");
        case PageDevice::Kind::Reader:
            return language.text("DEVICE_READER");
        case PageDevice::Kind::Browser:
            return language.text(device.isThis ? "DEVICE_THIS" : "DEVICE_BROWSER");
    }
    return "";
}

std::string addressOf(const PageDevice& device) {
    const char* kind = device.kind == PageDevice::Kind::Browser ? "/me/browsers/" : "/me/devices/";
    return kind + std::to_string(device.id) + "/end";
}

std::string sinceOf(const PageDevice& device, const PageContext& context) {
    return context.language.text("DEVICE_SINCE", {context.language.moment(device.made, context.now)});
}

}  // namespace

std::string DevicesPage::html(const PageContext& context, const std::vector<PageDevice>& devices) {
    const PageLanguage& language = context.language;
    PageBuilder page(language, context.token);
    page.bar(language.text("MY_DEVICES"), "/me");
    page.openCard();
    page.html().open("ul");
    for (const PageDevice& device : devices) {
        const std::string kind = kindOf(device, language);
        page.html().open("li").open("div", {{"class", "row"}}).open("span", {{"class", "grow"}});
        page.html()
            .leaf("span", {{"class", "strong"}}, kind)
            .leaf("span", {{"class", "soft"}}, sinceOf(device, context));
        if (device.kind != PageDevice::Kind::Browser) {
            page.html().leaf("span", {{"class", "soft"}},
                             device.heard ? language.text("DEVICE_HEARD", {language.moment(*device.heard, context.now)})
                                          : language.text("NOTHING_YET"));
        }
        const std::string spoken =
            language.text("DEVICE_END_SPOKEN", {kind + ", " + language.moment(device.made, context.now)});
        page.html().close().open("a", {{"class", "end"}, {"href", addressOf(device)}, {"aria-label", spoken}});
        page.html().text(language.text("DEVICE_END")).close().close().close();
    }
    page.html().close();
    page.linkRow("/me/phone", language.text("SET_UP_PHONE"));
    page.close();
    page.html().open("div", {{"class", "buttons"}});
    page.openForm("/me/devices/link");
    page.button(PageBuilder::Button::Quiet, language.text("LINK_COMPUTER"));
    page.close();
    page.close();
    return page.finish(language.text("MY_DEVICES"));
}

std::string DevicesPage::linkHtml(const PageContext& context, const std::string& link) {
    const PageLanguage& language = context.language;
    PageBuilder page(language, context.token);
    page.bar(language.text("LINK_COMPUTER"), "/me/devices");
    page.words(language.text("LINK_COMPUTER_TEXT"));
    page.openCard();
    page.html().open("div", {{"class", "field"}});
    page.html().leaf("p", {{"class", "value"}, {"dir", "ltr"}, {"translate", "no"}}, link).close();
    page.close();
    return page.finish(language.text("LINK_COMPUTER"));
}

std::string DevicesPage::endHtml(const PageContext& context, const PageDevice& device) {
    const PageLanguage& language = context.language;
    const std::string title = language.text("DEVICE_END_SPOKEN", {kindOf(device, language)});
    PageBuilder page(language, context.token);
    page.bar(title, "/me/devices");
    page.words(sinceOf(device, context));
    page.words(language.text("DEVICE_ASK"));
    page.html().open("div", {{"class", "buttons"}});
    page.openForm(addressOf(device));
    page.button(PageBuilder::Button::Main, language.text("DEVICE_END"));
    page.close();
    page.linkButton(PageBuilder::Button::Quiet, "/me/devices", language.text("KEEP"));
    page.close();
    return page.finish(title);
}

}  // namespace ktr::server
