#include "server/page/FencesPage.h"

#include "server/page/PageBuilder.h"

namespace ktr::server {

namespace {

std::string placeOf(const Fence& fence, const PageLanguage& language) {
    return fence.name.empty() ? language.coordinates(fence.circle.latitude, fence.circle.longitude, true)
                              : shownName(fence.name);
}

void addRow(PageBuilder& page, const PageContext& context, const FenceFacts& one) {
    const PageLanguage& language = context.language;
    const std::string what =
        language.text(one.fence.arrives ? "TOLD_ARRIVING" : "TOLD_LEAVING", {placeOf(one.fence, language)});
    page.html().open("li");
    page.openForm("/me/fences/" + std::to_string(one.fence.id) + "/end");
    page.html().open("div", {{"class", "row"}});
    page.face(one.other, one.handle.empty() ? one.other : one.handle);
    page.html().open("span", {{"class", "grow"}});
    page.html().open("span", {{"class", "name"}}).leaf("bdi", {}, shownName(one.other)).close();
    page.html().leaf("span", {{"class", "soft"}}, what);
    page.html().leaf("span", {{"class", "soft"}},
                     language.text("DEVICE_SINCE", {language.moment(one.fence.made, context.now)}));
    page.html().close();
    const std::string spoken = language.text("DEVICE_END_SPOKEN", {shownName(one.other) + ", " + what});
    page.html().open("button", {{"class", "end"}, {"aria-label", spoken}}).text(language.text("DEVICE_END")).close();
    page.html().close();
    page.close();
    page.html().close();
}

}  // namespace

std::string FencesPage::html(const PageContext& context, const std::vector<FenceFacts>& fences) {
    const PageLanguage& language = context.language;
    PageBuilder page(language, context.token);
    page.bar(language.text("TOLD_TITLE"), "/me");
    page.openCard();
    if (fences.empty()) {
        page.html().open("div", {{"class", "row"}}).text(language.text("TOLD_NOBODY")).close();
    } else {
        page.html().open("ul");
        for (const FenceFacts& one : fences) {
            addRow(page, context, one);
        }
        page.html().close();
    }
    page.close();
    return page.finish(language.text("TOLD_TITLE"));
}

}  // namespace ktr::server
