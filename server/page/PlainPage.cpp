#include "server/page/PlainPage.h"

#include "server/page/PageBuilder.h"

namespace ktr::server {

std::string PlainPage::linkHtml(const PageLanguage& language, const std::string& link) {
    PageBuilder page(language, "");
    page.brand("ktr");
    page.heading(language.text("LINK_TITLE"));
    page.words(language.text("LINK_TEXT"));
    page.html().open("div", {{"class", "buttons"}});
    page.openForm("/me/in");
    page.hiddenField("link", link);
    page.button(PageBuilder::Button::Main, language.text("LINK_OPEN"));
    page.close();
    page.close();
    return page.finish(language.text("LINK_TITLE"));
}

std::string PlainPage::signedOutHtml(const PageLanguage& language) {
    return sayingHtml(language, language.text("SIGNED_OUT"), language.text("SIGNED_OUT_TEXT"), false);
}

std::string PlainPage::sayingHtml(const PageLanguage& language, const std::string& title, const std::string& more,
                                  bool leadsBack) {
    PageBuilder page(language, "");
    page.brand("ktr");
    page.heading(title);
    if (!more.empty()) {
        page.words(more);
    }
    if (leadsBack) {
        page.html().open("div", {{"class", "buttons"}});
        page.linkButton(PageBuilder::Button::Main, "/me", language.text("TO_MY_PAGE"));
        page.close();
    }
    return page.finish(title);
}

}  // namespace ktr::server
