#include "server/page/OwnPages.h"

#include <algorithm>
#include <charconv>

#include "platform/base/Json.h"
#include "server/page/DevicesPage.h"
#include "server/page/FencesPage.h"
#include "server/page/PageAnswer.h"
#include "server/page/PageTexts.h"
#include "server/page/PhonePage.h"
#include "server/page/PlainPage.h"
#include "server/page/RuleForm.h"
#include "server/page/RulePage.h"
#include "server/page/SettingsPage.h"
#include "server/rules/WallClock.h"
#include "server/store/Secret.h"

namespace ktr::server {

namespace {

constexpr long kLanguageLasts = 365L * 86400;

HttpResponse saying(int status, const PageContext& context, const char* title) {
    return PageAnswer::html(status, PlainPage::sayingHtml(context.language, context.language.text(title), "", true));
}

HttpResponse notKept(const PageContext& context) {
    return saying(503, context, "NOT_KEPT");
}

HttpResponse noSuchPage(const PageContext& context) {
    return saying(404, context, "NO_SUCH_PAGE");
}

std::string addressOf(const PageRule& rule) {
    return "/me/sees/" + std::to_string(rule.viewer);
}

std::optional<std::int64_t> wholeNumber(const std::string& text) {
    std::int64_t value = 0;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), value);
    return error == std::errc() && end == text.data() + text.size() ? std::optional(value) : std::nullopt;
}

}  // namespace

HttpResponse OwnPages::answer(const PageRequest& request, const Reader& reader) {
    return request.posts ? change(request, reader) : show(request, reader);
}

HttpResponse OwnPages::show(const PageRequest& request, const Reader& reader) {
    const PageContext& context = reader.context;
    if (request.is({})) {
        return PageAnswer::html(200, SharingPage::html(context, sharingOf(reader)));
    }
    if (request.is({"share"})) {
        return PageAnswer::html(200, SharingPage::shareHtml(context, "", ""));
    }
    if (request.is({"looks"})) {
        const auto kept = store_.retention(reader.person.id).value_or(Retention());
        return PageAnswer::html(200, SharingPage::looksHtml(context, looksOf(reader), kept.looks / 86400));
    }
    if (request.is({"phone"})) {
        return PageAnswer::html(200, PhonePage::beginHtml(context));
    }
    if (request.is({"devices"})) {
        return PageAnswer::html(200, DevicesPage::html(context, devicesOf(reader)));
    }
    if (request.is({"settings"})) {
        const auto kept = store_.retention(reader.person.id).value_or(Retention());
        const bool saved = request.query.find("saved").has_value();
        return PageAnswer::html(
            200, SettingsPage::html(context, {kept.fixes, kept.looks, saved ? context.language.text("SAVED") : ""}));
    }
    if (request.is({"copy"})) {
        const auto everything = store_.everythingOf(reader.person.id);
        return everything ? PageAnswer::file("ktr.json", "application/json", platform::writeJson(*everything) + "\n")
                          : notKept(context);
    }
    if (request.is({"delete"})) {
        return PageAnswer::html(200, SettingsPage::deleteHtml(context));
    }
    if (request.is({"fences"})) {
        const auto fences = store_.fencesAbout(reader.person.id);
        return fences ? PageAnswer::html(200, FencesPage::html(context, *fences)) : notKept(context);
    }
    if (request.is({"places"})) {
        return placesPage(reader, 200, "", nullptr);
    }
    if (request.is({"places", "*"}) || request.is({"places", "*", "remove"})) {
        return showPlace(request, reader);
    }
    if (request.is({"sees", "*"}) || request.is({"sees", "*", "stop"})) {
        return showRule(request, reader);
    }
    if (request.is({"phone", "*"})) {
        return showPhone(request, reader);
    }
    if (request.is({"devices", "*", "end"}) || request.is({"browsers", "*", "end"})) {
        return showDeviceEnd(request, reader);
    }
    return noSuchPage(context);
}

HttpResponse OwnPages::change(const PageRequest& request, const Reader& reader) {
    if (request.is({"out"})) {
        if (!store_.endBrowser(reader.person.id, reader.browser.id)) {
            return notKept(reader.context);
        }
        HttpResponse response = PageAnswer::seeOther("/me");
        PageAnswer::setCookie(response, PageAnswer::kSession, "", 0);
        return response;
    }
    if (request.is({"visible"})) {
        return changeVisible(request, reader);
    }
    if (request.is({"share"}) || request.is({"share", "with"})) {
        return beginSharing(request, reader);
    }
    if (request.is({"sees", "*"})) {
        return changeRule(request, reader);
    }
    if (request.is({"asked", "*", "no"})) {
        return store_.endAsk(reader.person.id, request.number(1)) ? PageAnswer::seeOther("/me")
                                                                  : notKept(reader.context);
    }
    if (request.is({"sees", "*", "stop"}) || request.is({"sees", "*", "keep"})) {
        return stopSharing(request, reader);
    }
    if (request.is({"phone"})) {
        return makePhone(request, reader);
    }
    if (request.is({"devices", "link"})) {
        return makeLink(request, reader);
    }
    if (request.is({"devices", "*", "end"}) || request.is({"browsers", "*", "end"})) {
        return endDevice(request, reader);
    }
    if (request.is({"settings"})) {
        return changeSettings(request, reader);
    }
    if (request.is({"places"}) || request.is({"places", "*", "remove"})) {
        return changePlaces(request, reader);
    }
    if (request.is({"fences", "*", "end"})) {
        return store_.endFence(reader.person.id, request.number(1)) == FenceOutcome::Failed
                   ? notKept(reader.context)
                   : PageAnswer::seeOther("/me/fences");
    }
    if (request.is({"places", "*"})) {
        return changePlace(request, reader);
    }
    if (request.is({"delete"})) {
        return deleteAll(reader);
    }
    return noSuchPage(reader.context);
}

SharingPage::Data OwnPages::sharingOf(const Reader& reader) {
    SharingPage::Data data;
    data.hidden = reader.person.hidden;
    const auto places = store_.placesOf(reader.person.id);
    for (const auto& [name, grant] : store_.grantsOf(reader.person.id)) {
        const auto viewer = store_.personNamed(name);
        if (!viewer) {
            continue;
        }
        const auto place = std::find_if(places.begin(), places.end(),
                                        [&, id = grant.arrival](const NamedPlace& one) { return one.id == id; });
        data.rules.push_back({viewer->id, name, viewer->handles.empty() ? name : viewer->handles.front(), grant,
                              place == places.end() ? std::string() : place->name});
    }
    for (const AskedBy& ask : store_.askersOf(reader.person.id, reader.context.now).value_or(std::vector<AskedBy>())) {
        data.asks.push_back({ask.asker, ask.name, ask.handle, ask.time});
    }
    data.looks = looksOf(reader);
    data.looksKept = store_.retention(reader.person.id).value_or(Retention()).looks / 86400;
    return data;
}

std::vector<PageLook> OwnPages::looksOf(const Reader& reader) {
    std::vector<PageLook> looks;
    for (const Look& look : store_.looksAt(reader.person.id)) {
        looks.push_back({look.viewer, look.hour, look.asked});
    }
    return looks;
}

std::vector<PageDevice> OwnPages::devicesOf(const Reader& reader) {
    std::vector<PageDevice> devices;
    for (const DeviceFacts& device : store_.devicesOf(reader.person.id)) {
        if (!device.revoked) {
            const bool isPhone = device.kind == DeviceKind::Phone;
            devices.push_back(
                {device.id, isPhone ? PageDevice::Kind::Phone : PageDevice::Kind::Reader, device.made, device.heard});
        }
    }
    for (const Browser& browser : store_.browsersOf(reader.person.id, reader.context.now)) {
        devices.push_back(
            {browser.id, PageDevice::Kind::Browser, browser.made, std::nullopt, browser.id == reader.browser.id});
    }
    return devices;
}

std::optional<PageRule> OwnPages::ruleOf(const Reader& reader, std::int64_t viewer) {
    const auto data = sharingOf(reader);
    const auto rule =
        std::find_if(data.rules.begin(), data.rules.end(), [&](const PageRule& one) { return one.viewer == viewer; });
    return rule == data.rules.end() ? std::nullopt : std::optional(*rule);
}

std::optional<Person> OwnPages::named(const std::string& words) {
    if (auto person = store_.personNamed(words)) {
        return person;
    }
    const auto id = words.size() < 3 ? std::nullopt : store_.personOf(words);
    return id ? store_.person(*id) : std::nullopt;
}

std::string OwnPages::ruleHtml(const Reader& reader, const PageRule& rule, const std::string& told, bool isComplaint) {
    // The same reading as for the viewer's own answer.
    const auto sharing = store_.sharing(rule.viewer, reader.person.id);
    RulePage::Data data{rule, false, "", std::nullopt, store_.placesOf(reader.person.id), told, isComplaint};
    data.seen = sharing ? Visibility::visible(*sharing, reader.context.now) : std::nullopt;
    return RulePage::html(reader.context, data);
}

HttpResponse OwnPages::showRule(const PageRequest& request, const Reader& reader) {
    const auto rule = ruleOf(reader, request.number(1));
    if (!rule) {
        return noSuchPage(reader.context);
    }
    if (request.parts.size() > 2) {
        return PageAnswer::html(200, RulePage::stopHtml(reader.context, *rule));
    }
    const bool saved = request.query.find("saved").has_value();
    return PageAnswer::html(200, ruleHtml(reader, *rule, saved ? reader.context.language.text("SAVED") : "", false));
}

HttpResponse OwnPages::showPhone(const PageRequest& request, const Reader& reader) {
    for (const PageDevice& device : devicesOf(reader)) {
        if (device.kind == PageDevice::Kind::Phone && device.id == request.number(1)) {
            PhonePage::Data data{"https://" + request.host + "/pub", "", "", "", device.id, device.made, device.heard};
            if (const auto fix = store_.newestFix(reader.person.id); fix && device.heard) {
                data.accuracy = fix->accuracy;
            }
            return PageAnswer::html(200, PhonePage::html(reader.context, data));
        }
    }
    return noSuchPage(reader.context);
}

HttpResponse OwnPages::showDeviceEnd(const PageRequest& request, const Reader& reader) {
    for (const PageDevice& device : devicesOf(reader)) {
        const bool isBrowser = device.kind == PageDevice::Kind::Browser;
        if (device.id == request.number(1) && isBrowser == (request.parts[0] == "browsers")) {
            return PageAnswer::html(200, DevicesPage::endHtml(reader.context, device));
        }
    }
    return noSuchPage(reader.context);
}

HttpResponse OwnPages::changeVisible(const PageRequest& request, const Reader& reader) {
    const std::string state = request.field("state");
    if (state != "on" && state != "off") {
        return saying(400, reader.context, "NOT_UNDERSTOOD");
    }
    const bool hides = state == "off";
    if (!store_.setHidden(reader.person.id, hides, reader.context.now)) {
        return notKept(reader.context);
    }
    if (!hides) {
        // After a restore programs wait for their person's word.
        store_.confirm(reader.person.id);
    }
    return PageAnswer::seeOther("/me");
}

HttpResponse OwnPages::beginSharing(const PageRequest& request, const Reader& reader) {
    const PageContext& context = reader.context;
    const std::string typed = request.field("who");
    const auto viewer = named(typed);
    if (!viewer || viewer->id == reader.person.id) {
        const char* complaint = viewer ? "SHARE_SELF" : "SHARE_UNKNOWN";
        return PageAnswer::html(400, SharingPage::shareHtml(context, typed, context.language.text(complaint)));
    }
    PageRule rule{viewer->id, viewer->name, viewer->handles.empty() ? viewer->name : viewer->handles.front()};
    rule.grant.precision = Precision::Town;
    rule.grant.from = context.now;
    const auto places = store_.placesOf(reader.person.id);
    if (request.parts.size() == 1) {
        return PageAnswer::html(200, RulePage::html(context, {rule, true, typed, std::nullopt, places}));
    }
    const auto [grant, complaint] = RuleForm::read(request.form, context, places, std::nullopt);
    if (!grant) {
        const RulePage::Data data{rule, true, typed, std::nullopt, places, context.language.text(complaint), true};
        return PageAnswer::html(400, RulePage::html(context, data));
    }
    return store_.grant(reader.person.id, viewer->id, *grant) ? PageAnswer::seeOther(addressOf(rule) + "?saved")
                                                              : notKept(context);
}

HttpResponse OwnPages::changeRule(const PageRequest& request, const Reader& reader) {
    const PageContext& context = reader.context;
    const auto rule = ruleOf(reader, request.number(1));
    if (!rule) {
        return noSuchPage(context);
    }
    const auto places = store_.placesOf(reader.person.id);
    const auto [grant, complaint] = RuleForm::read(request.form, context, places, rule->grant);
    if (!grant) {
        return PageAnswer::html(400, ruleHtml(reader, *rule, context.language.text(complaint), true));
    }
    return store_.grant(reader.person.id, rule->viewer, *grant) ? PageAnswer::seeOther(addressOf(*rule) + "?saved")
                                                                : notKept(context);
}

HttpResponse OwnPages::stopSharing(const PageRequest& request, const Reader& reader) {
    const auto rule = ruleOf(reader, request.number(1));
    if (!rule) {
        // It has ended already: that is what was wanted.
        return PageAnswer::seeOther("/me");
    }
    if (request.parts[2] == "keep") {
        const auto outcome = store_.confirmGrant(reader.person.id, rule->viewer, reader.context.now);
        return outcome == Confirmation::Failed ? notKept(reader.context)
                                               : PageAnswer::seeOther(addressOf(*rule) + "?saved");
    }
    if (!store_.revokeGrant(reader.person.id, rule->viewer) && ruleOf(reader, rule->viewer)) {
        return notKept(reader.context);
    }
    return PageAnswer::seeOther("/me");
}

HttpResponse OwnPages::makePhone(const PageRequest& request, const Reader& reader) {
    const PageContext& context = reader.context;
    const auto secret = Secret::make();
    const auto link = Secret::make();
    const std::int64_t device =
        secret && link ? store_.addPhoneWithLink(reader.person.id, *secret, *link, context.now) : 0;
    if (device == 0) {
        return notKept(context);
    }
    const std::string origin = "https://" + request.host;
    return PageAnswer::html(200, PhonePage::html(context, {origin + "/pub", origin + "/?id=" + *secret, *secret,
                                                           origin + "/me/in?link=" + *link, device, context.now}));
}

HttpResponse OwnPages::endDevice(const PageRequest& request, const Reader& reader) {
    const std::int64_t id = request.number(1);
    if (request.parts[0] == "browsers") {
        return store_.endBrowser(reader.person.id, id) ? PageAnswer::seeOther("/me/devices") : notKept(reader.context);
    }
    if (!store_.revokeDevice(reader.person.id, id, reader.context.now)) {
        const auto devices = devicesOf(reader);
        const bool isThere =
            std::any_of(devices.begin(), devices.end(), [&](const PageDevice& device) { return device.id == id; });
        return isThere ? notKept(reader.context) : PageAnswer::seeOther("/me/devices");
    }
    return PageAnswer::seeOther("/me/devices");
}

HttpResponse OwnPages::changeSettings(const PageRequest& request, const Reader& reader) {
    const PageContext& context = reader.context;
    const auto places = wholeNumber(request.field("places"));
    const auto looks = wholeNumber(request.field("looks"));
    const std::string zone = request.field("zone");
    const std::string language = request.field("language");
    const auto& languages = PageTexts::languages();
    if (!places || *places < 3600 || *places > Retention::kLongestFixes || !looks || *looks < 3600 ||
        *looks > Retention::kLongestLooks || !WallClock::isZone(zone) ||
        std::find(languages.begin(), languages.end(), language) == languages.end()) {
        return saying(400, context, "NOT_UNDERSTOOD");
    }
    if (!store_.setRetention(reader.person.id, {*places, *looks}, context.now) ||
        !store_.setZone(reader.person.id, zone)) {
        return notKept(context);
    }
    HttpResponse response = PageAnswer::seeOther("/me/settings?saved");
    PageAnswer::setCookie(response, PageAnswer::kLanguage, language, kLanguageLasts);
    return response;
}

HttpResponse OwnPages::makeLink(const PageRequest& request, const Reader& reader) {
    const auto link = Secret::make();
    if (!link || !store_.addSignIn(reader.person.id, *link, reader.context.now)) {
        return notKept(reader.context);
    }
    const std::string address = "https://" + request.host + "/me/in?link=" + *link;
    return PageAnswer::html(200, DevicesPage::linkHtml(reader.context, address));
}

HttpResponse OwnPages::deleteAll(const Reader& reader) {
    if (!store_.forget(reader.person.id, reader.context.now)) {
        return notKept(reader.context);
    }
    HttpResponse response = PageAnswer::html(
        200, PlainPage::sayingHtml(reader.context.language, reader.context.language.text("DELETED"), "", false));
    PageAnswer::setCookie(response, PageAnswer::kSession, "", 0);
    return response;
}

}  // namespace ktr::server
