#include "server/page/PhonePage.h"

#include "server/page/PageBuilder.h"
#include "server/page/QrCode.h"

namespace ktr::server {

namespace {

/// Begins a step; close it.
void openStep(PageBuilder& page, std::int64_t number, const char* key) {
    page.html().open("li").leaf("span", {{"class", "disc"}, {"aria-hidden", "true"}}, page.language().number(number));
    page.html().leaf("p", {}, page.language().text(key));
}

void addValue(PageBuilder& page, const char* key, const std::string& value) {
    page.html().open("div", {{"class", "field"}}).leaf("dt", {}, page.language().text(key));
    page.html().leaf("dd", {{"dir", "ltr"}, {"translate", "no"}}, value).close();
}

void addValues(PageBuilder& page, const PageContext& context, const PhonePage::Data& data) {
    const PageLanguage& language = context.language;
    page.html().open("div", {{"class", "wide"}}).open("dl", {{"class", "card"}});
    addValue(page, "ADDRESS", data.address);
    addValue(page, "USER", context.name);
    if (!data.password.empty()) {
        addValue(page, "PASSWORD", data.password);
    } else {
        page.html().open("div", {{"class", "field"}}).leaf("dt", {}, language.text("PASSWORD"));
        page.html().leaf("dd", {{"class", "plain"}},
                         language.text("WAS_SHOWN", {language.day(data.made, context.now)}));
        page.close();
    }
    page.close();
    if (!data.password.empty()) {
        page.warning(language.text("SHOWN_ONCE"));
        page.note(language.text("ADDRESS_ALONE"));
        page.html().leaf("p", {{"class", "note value"}, {"dir", "ltr"}, {"translate", "no"}}, data.addressAlone);
    }
    page.close();
}

std::string stateOf(const PageContext& context, const PhonePage::Data& data) {
    const PageLanguage& language = context.language;
    if (!data.heard) {
        return language.text("NOTHING_YET");
    }
    const std::string time = language.moment(*data.heard, context.now);
    return data.accuracy ? language.text("HERE_SINCE", {time, language.metres(*data.accuracy)})
                         : language.text("HERE_SINCE_TIME", {time});
}

void addCode(PageBuilder& page, const std::string& link) {
    const auto code = QrCode::of(link);
    if (!code) {
        return;
    }
    const std::string side = std::to_string(code->side);
    page.html().open("div", {{"class", "apart-far"}});
    page.note(page.language().text("OTHER_PHONE"));
    page.html().open("div", {{"class", "code"}});
    page.html().open("svg", {{"width", "160"},
                             {"height", "160"},
                             {"viewBox", "0 0 " + side + " " + side},
                             {"shape-rendering", "crispEdges"},
                             {"role", "img"},
                             {"aria-label", page.language().text("CODE")}});
    page.html().leaf("path", {{"d", code->path()}, {"fill", "#000"}}, "").close();
    page.close();
    page.close();
}

}  // namespace

std::string PhonePage::beginHtml(const PageContext& context) {
    const PageLanguage& language = context.language;
    PageBuilder page(language, context.token);
    page.bar(language.text("SET_UP_PHONE"), "/me");
    page.html().open("ol", {{"class", "steps"}});
    openStep(page, 1, "STEP_INSTALL");
    page.close();
    page.html().close().open("div", {{"class", "buttons"}});
    page.openForm("/me/phone");
    page.button(PageBuilder::Button::Main, language.text("MAKE_PASSWORD"));
    page.close();
    page.close();
    return page.finish(language.text("SET_UP_PHONE"));
}

std::string PhonePage::html(const PageContext& context, const Data& data) {
    const PageLanguage& language = context.language;
    PageBuilder page(language, context.token);
    page.bar(language.text("SET_UP_PHONE"), "/me");
    page.html().open("ol", {{"class", "steps"}});
    openStep(page, 1, "STEP_INSTALL");
    page.close();
    openStep(page, 2, "STEP_TYPE");
    addValues(page, context, data);
    page.close();
    openStep(page, 3, "STEP_RUN");
    page.html().leaf("p", {{"class", "soft second"}, {"role", "status"}}, stateOf(context, data));
    page.close();
    page.html().close().open("div", {{"class", "buttons"}});
    page.html().open("a", {{"class", "outlined"}, {"href", "/me/phone/" + std::to_string(data.device)}});
    page.html().open("span", {{"class", "beside"}});
    page.reloadIcon();
    page.html().text(language.text("LOOK_AGAIN")).close().close();
    page.close();
    if (!data.link.empty()) {
        addCode(page, data.link);
    }
    return page.finish(language.text("SET_UP_PHONE"));
}

}  // namespace ktr::server
